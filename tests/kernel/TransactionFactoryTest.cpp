#include "tarnkiln/kernel/TransactionFactory.h"

#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;

/// Passes on to another model's factory, and counts.
class CountingFactory : public AbstractTransactionFactoryImpl
{
public:
    explicit CountingFactory(AbstractTransactionFactoryImpl const& target) : m_target(target) {}

    Transaction beginTransaction() const override
    {
        ++defaults;
        return m_target.beginTransaction();
    }
    Transaction beginRevertibleTransaction() const override
    {
        ++revertibles;
        return m_target.beginRevertibleTransaction();
    }

    mutable int defaults = 0;
    mutable int revertibles = 0;

private:
    AbstractTransactionFactoryImpl const& m_target;
};

TEST(TransactionFactory, OfTheModelBeginsWithALocalOrigin)
{
    Model const model = Model::create(ModelConstellation());
    UUID previous{};
    for (bool const revertible : {false, true})
    {
        Transaction const transaction = model->beginTransaction(revertible);
        meta::TransactionOrigin const& origin = transaction->getOrigin();

        EXPECT_EQ(model->getUuid(), origin.getModel());
        EXPECT_EQ(meta::Language::CPlusPlus, origin.getLanguage());
        EXPECT_EQ(1, static_cast<int>(origin.getLanguage()));
        EXPECT_FALSE(origin.getTransactionId().is_nil());
        EXPECT_NE(previous, origin.getTransactionId());
        EXPECT_FALSE(origin.getSynchronizer());
        previous = origin.getTransactionId();
        transaction.commit();
    }
}

TEST(TransactionFactory, OfTheModelIsAskedByItsKindOfTransaction)
{
    Model const model = Model::createTransientModel();
    AbstractTransactionFactoryImpl const& factory = model->getDefaultTransactionFactory();

    EXPECT_EQ(TransactionResult::Committed, factory.beginTransaction().commit());
    Plain const element = Plain::create(model);
    Transaction const transaction = factory.beginRevertibleTransaction();
    change(element, 1);
    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
}

TEST(TransactionFactory, MayBeDelegatedToAnotherParty)
{
    Model const other = Model::createTransientModel();
    CountingFactory const target(other->getDefaultTransactionFactory());
    Model const model = Model::createTransientModel();
    model->setTransactionFactory(std::make_unique<DelegatingTransactionFactoryImpl>(target));

    Transaction const transaction = model->beginTransaction(false);
    EXPECT_EQ(1, target.defaults);
    EXPECT_EQ(0, target.revertibles);
    EXPECT_NE(nullptr, other->getCurrentTransaction());
    EXPECT_EQ(nullptr, model->getCurrentTransaction());

    Transaction const nested = model->beginTransaction(true);
    EXPECT_EQ(1, target.revertibles);
    nested.commit();
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
}

TEST(TransactionFactory, IsTheLocalOneAgainWhenNoneIsSet)
{
    Model const other = Model::createTransientModel();
    Model const model = Model::createTransientModel();
    model->setTransactionFactory(
        std::make_unique<DelegatingTransactionFactoryImpl>(other->getDefaultTransactionFactory()));
    model->setTransactionFactory(nullptr);

    Transaction const transaction = model->beginTransaction(false);

    EXPECT_NE(nullptr, model->getCurrentTransaction());
}

TEST(TransactionOrigin, TravelsUnchangedIntoEveryReport)
{
    Model const model = Model::createTransientModel();
    ScriptedListener listener;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(false);
    Plain::create(model);
    meta::TransactionOrigin const origin = transaction->getOrigin();
    transaction.commit();

    EXPECT_EQ(origin, listener.prepared.at(0)->getOrigin());
    EXPECT_EQ(origin, listener.validated.at(0)->getOrigin());
    EXPECT_EQ(origin, listener.committed.at(0)->getOrigin());
}
}  // namespace
