// Setters of plain properties in a transaction that is open, be there somebody who hears of it.
#include "shapes/Scalars.h"
#include "shapes/ScalarsImpl.h"
#include "tests/generated/ShapesFixture.h"

namespace testkit::shapes {
namespace {

using tarnkiln::messages::ModelFrozen;

class PlainSetter : public ShapesTest
{
protected:
    /// Lets nothing follow but a rollback.
    void doom() const { Transaction const dropped = m_model->beginTransaction(false); }

    Scalars const element = Scalars::create(m_model);
};

TEST_F(PlainSetter, KeepsTheTransactionGoing)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
    element->setInteger(1);
    element->setText(u"one");

    EXPECT_FALSE(transaction.isRollBackOnly());
    transaction.commit();
    EXPECT_EQ(element->getInteger(), 1);
    EXPECT_EQ(element->getText(), u"one");
    EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
}

TEST_F(PlainSetter, ChangesTheVersionOfTheModel)
{
    std::uint64_t const before = m_model->getAnchor().get()->getSettledVersion();
    {
        Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
        element->setInteger(1);
        transaction.commit();
    }
    EXPECT_NE(m_model->getAnchor().get()->getSettledVersion(), before);
}

TEST_F(PlainSetter, EndsADoomedTransactionAtOnceWhateverIsKeptOfIt)
{
    for (bool const revertible : {false, true})
    {
        element->setInteger(0);
        Transaction const transaction = m_model->beginTransaction(revertible);
        doom();
        ASSERT_TRUE(transaction.isRollBackOnly());

        element->setInteger(1);

        EXPECT_EQ(m_model->getCurrentTransaction(), nullptr);
        EXPECT_EQ(transaction.commit(), TransactionResult::NotCompleted);
        EXPECT_EQ(element->getInteger(), revertible ? 0 : 1);
    }
}

TEST_F(PlainSetter, TellsTheFirstChangeOnlyOnce)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
    element->setInteger(1);
    int calls = 0;
    transaction.addFirstChangeCallback([&] {
        ++calls;
        EXPECT_EQ(element->getInteger(), 1);
    });
    element->setInteger(2);
    element->setInteger(3);

    EXPECT_EQ(calls, 1);
    EXPECT_EQ(element->getInteger(), 3);
}

TEST_F(PlainSetter, DoomsTheTransactionWhereTheModelIsFrozen)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
    {
        Model::Freezer const freezer(m_model);
        EXPECT_RAISES(ModelFrozen, element->setInteger(1));
    }
    EXPECT_TRUE(transaction.isRollBackOnly());
    EXPECT_EQ(element->getInteger(), 0);
}
}  // namespace
}  // namespace testkit::shapes
