#include "tarnkiln/kernel/Transaction.h"

#include "tests/support/ExpectRaises.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

namespace {

using namespace testkit;

class FirstChangeCallback : public testing::Test
{
protected:
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    int calls = 0;
};

TEST_F(FirstChangeCallback, RunsOnceBeforeTheFirstChange)
{
    Transaction const transaction = model->beginTransaction(true);
    int seen = -1;
    transaction.addFirstChangeCallback([&] {
        ++calls;
        seen = element->getValue();
    });
    EXPECT_EQ(0, calls);

    change(element, 1);
    change(element, 2);
    Plain::create(model);

    EXPECT_EQ(1, calls);
    EXPECT_EQ(0, seen);
}

TEST_F(FirstChangeCallback, DoesNotRunWithoutAChange)
{
    Transaction const transaction = model->beginTransaction(true);
    transaction.addFirstChangeCallback([&] { ++calls; });
    transaction.commit();

    EXPECT_EQ(0, calls);
}

TEST_F(FirstChangeCallback, RunsForEachKindOfChange)
{
    std::vector<std::function<void()>> const kinds = {
        [&] { change(element, 1); },
        [&] { Plain::create(model); },
        [&] { model->allElementsDestroying(); },
        [&] { element->destroy(); },
    };
    for (auto const& kind : kinds)
    {
        calls = 0;
        Transaction const transaction = model->beginTransaction(true);
        transaction.addFirstChangeCallback([&] { ++calls; });
        kind();
        EXPECT_EQ(1, calls);
        transaction.rollBack();
    }
}

TEST_F(FirstChangeCallback, SwitchesTheRecordingOfAShallowTransactionOn)
{
    Transaction const transaction = model->beginTransaction(false);
    transaction.addFirstChangeCallback([&] { ++calls; });
    change(element, 1);

    EXPECT_EQ(1, calls);
    EXPECT_EQ(TransactionResult::NotRevertible, transaction.rollBack());
}

TEST_F(FirstChangeCallback, OfAReplacedOneIsForgotten)
{
    Transaction const transaction = model->beginTransaction(true);
    transaction.addFirstChangeCallback([&] { calls += 100; });
    transaction.addFirstChangeCallback([&] { ++calls; });
    change(element, 1);

    EXPECT_EQ(1, calls);
}

TEST_F(FirstChangeCallback, MayBeReplacedByNone)
{
    Transaction const transaction = model->beginTransaction(false);
    transaction.addFirstChangeCallback([&] { ++calls; });
    transaction.addFirstChangeCallback({});
    change(element, 1);

    EXPECT_EQ(0, calls);
    EXPECT_EQ(TransactionResult::NotCompleted, transaction.rollBack());
}

TEST_F(FirstChangeCallback, AddedAfterTheFirstChangeDoesNotRun)
{
    Transaction const transaction = model->beginTransaction(true);
    change(element, 1);
    transaction.addFirstChangeCallback([&] { ++calls; });
    change(element, 2);

    EXPECT_EQ(0, calls);
}

TEST_F(FirstChangeCallback, MayChangeTheModelItself)
{
    Transaction const transaction = model->beginTransaction(true);
    Plain created;
    transaction.addFirstChangeCallback([&] {
        ++calls;
        created = Plain::create(model);
        change(element, 10);
    });

    change(element, 1);

    EXPECT_EQ(1, calls);
    EXPECT_EQ(1, element->getValue());
    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
    EXPECT_EQ(0, element->getValue());
    EXPECT_FALSE(created);
}

TEST_F(FirstChangeCallback, MayReplaceItself)
{
    Transaction const transaction = model->beginTransaction(true);
    auto const counted = std::make_shared<int>();
    transaction.addFirstChangeCallback([this, &transaction, counted] {
        transaction.addFirstChangeCallback({});
        ++*counted;
        ++calls;
    });

    change(element, 1);

    EXPECT_EQ(1, calls);
    EXPECT_EQ(1, *counted);
    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
}

TEST_F(FirstChangeCallback, ThatThrowsLeavesTheTransactionAsItWas)
{
    ScriptedListener listener;
    Transaction setUp;
    listen(model, listener);
    Transaction const transaction = model->beginTransaction(true);
    bool throws = true;
    transaction.addFirstChangeCallback([&] {
        ++calls;
        if (throws)
            throw std::runtime_error("no");
    });

    EXPECT_THROW(change(element, 1), std::runtime_error);
    EXPECT_THROW(Plain::create(model), std::runtime_error);
    EXPECT_THROW(model->elementDestroying(element.getImpl()), std::runtime_error);
    EXPECT_EQ(0, element->getValue());
    EXPECT_EQ(1u, model->getElementCount());

    throws = false;
    change(element, 2);
    EXPECT_EQ(4, calls);
    EXPECT_EQ(TransactionResult::Committed, transaction.commit());
    ASSERT_EQ(1u, listener.committed.size());
    EXPECT_THAT(listener.committed[0]->getChanged(), testing::ElementsAre(element));
    EXPECT_TRUE(listener.committed[0]->getCreated().empty());
    EXPECT_TRUE(listener.committed[0]->getDestroyed().empty());
}

TEST_F(FirstChangeCallback, ThatEndsTheTransactionLeavesTheChangeWithoutOne)
{
    for (bool const commits : {true, false})
    {
        auto transaction = std::make_unique<Transaction>(model->beginTransaction(true));
        transaction->addFirstChangeCallback([&] {
            if (commits)
                transaction->commit();
            else
                transaction->rollBack();
            transaction.reset();
        });

        EXPECT_RAISES(messages::NoOpenTransaction, change(element, 1));

        EXPECT_EQ(0, element->getValue());
        EXPECT_EQ(nullptr, model->getCurrentTransaction());
    }
}
}  // namespace
