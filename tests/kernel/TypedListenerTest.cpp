// Listeners as clients write them.
#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tests/support/PlainChange.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

#include <memory>
#include <vector>

namespace {

using namespace testkit;
using testing::ElementsAre;

/// A client's listener for everything.
struct FullListener : Listener
{
    void transactionPreparing(ReportData& report) { tell("preparing", report); }
    bool transactionValidating(ReportData& report)
    {
        tell("validating", report);
        return accepts;
    }
    void transactionCommitted(ReportData& report) { tell("committed", report); }
    void transactionRolledBack(ReportData& report) { tell("rolled back", report); }
    void tell(char const* phase, ReportData& report)
    {
        heard.push_back(phase);
        changed = report.getChanged().size();
    }

    Trace heard;
    bool accepts = true;
    std::size_t changed = 0;
};

/// A client's listener for commits alone.
struct CommitListener : Listener
{
    void transactionCommitted(ReportData&) { ++commits; }
    void listenerRemoved() override { ++removals; }
    int commits = 0;
    int removals = 0;
};

/// A client's listener that needs no old values.
struct ShallowListener : Listener
{
    using ElementType = Plain;
    void transactionCommitted(ShallowChangeReport<Plain>& report)
    {
        report.doProcess([&](Plain const& element) { created.push_back(element); },
                         report.getCreated());
        report.doProcess([&](Plain const& element) { destroyed.push_back(element); },
                         report.getDestroyed());
        deep = report.getData().isDeep();
    }
    std::vector<Plain> created;
    std::vector<Plain> destroyed;
    bool deep = true;
};

TEST(TypedListener, GetsTheCallsThatItHasMethodsFor)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    FullListener full;
    CommitListener commits;
    model->addListener(&full);
    model->addListener(&commits);

    Transaction const accepted = model->beginTransaction(false);
    change(element, 1);
    accepted.commit();
    full.accepts = false;
    Transaction const refused = model->beginTransaction(false);
    change(element, 2);
    refused.commit();

    EXPECT_THAT(full.heard, ElementsAre("preparing", "validating", "committed", "preparing",
                                        "validating", "rolled back"));
    EXPECT_EQ(1u, full.changed);
    EXPECT_EQ(1, commits.commits);
    EXPECT_EQ(1, element->getValue());
    model->destroy();
    EXPECT_EQ(1, commits.removals);
}

TEST(TypedListener, IsAddedOnce)
{
    Model const model = Model::createTransientModel();
    CommitListener commits;
    ShallowListener shallow;
    model->addListener(&commits);
    model->addListener(&commits);
    model->addShallowListener(&shallow);
    model->addShallowListener(&shallow);

    EXPECT_EQ(2u, model->getListeners().size());
    model->destroy();
    EXPECT_EQ(1, commits.removals);
}

TEST(TypedListener, OfDeepKindMakesTransactionsDeep)
{
    Model const model = Model::createTransientModel();
    Plain const element = Plain::create(model);
    CommitListener commits;
    model->addListener(&commits);

    Transaction const transaction = model->beginTransaction(false);
    change(element, 1);

    EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
    model->removeListener(&commits);
}

TEST(TypedListener, OwnedIsDeletedWithItsModel)
{
    struct Owned : CommitListener
    {
        explicit Owned(bool& deleted) : deleted(deleted) {}
        ~Owned() override { deleted = true; }
        bool& deleted;
    };
    bool deleted = false;
    Model const model = Model::createTransientModel();
    model->addOwnedListener(std::make_unique<Owned>(deleted));
    EXPECT_FALSE(deleted);

    model->destroy();

    EXPECT_TRUE(deleted);
}

TEST(ShallowListener, LeavesTransactionsShallowAndSeesElementsOfItsClass)
{
    Model const model = Model::createTransientModel();
    Plain const old = Plain::create(model);
    ShallowListener listener;
    model->addShallowListener(&listener);

    Transaction const transaction = model->beginTransaction(false);
    Plain const created = Plain::create(model);
    old->destroy();
    transaction.commit();

    EXPECT_FALSE(listener.deep);
    EXPECT_THAT(listener.created, ElementsAre(created));
    EXPECT_THAT(listener.destroyed, ElementsAre(old));
    model->removeListener(&listener);
}

TEST(ShallowListener, DoesNotSeeWhatWasCreatedAndDestroyed)
{
    Model const model = Model::createTransientModel();
    ShallowListener listener;
    model->addShallowListener(&listener);

    Transaction const transaction = model->beginTransaction(false);
    Plain::create(model)->destroy();
    transaction.commit();

    EXPECT_FALSE(listener.deep) << "it was told";
    EXPECT_TRUE(listener.created.empty());
    EXPECT_TRUE(listener.destroyed.empty());
    model->removeListener(&listener);
}
}  // namespace
