#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tests/support/TracingConstellationListener.h"

#include <gmock/gmock.h>

namespace {

using namespace testkit;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

class AConstellationListener : public ::testing::Test
{
protected:
    ModelConstellation const home = ModelConstellation::create();
};

TEST_F(AConstellationListener, IsToldInTheOrderOfAddingAndWhenItGoes)
{
    Trace trace;
    {
        TracingListener first(trace, "first");
        TracingListener second(trace, "second");
        home->addConstellationListener(&first);
        home->addConstellationListener(&second);

        Model::create(home)->destroy();
        home->removeConstellationListener(&first);
        home->removeConstellationListener(&second);
    }

    EXPECT_THAT(trace,
                ElementsAre("first added", "second added", "first destroyed", "second destroyed",
                            "first removed", "second removed", "second gone", "first gone"));
}

TEST_F(AConstellationListener, IsDeletedIfItIsOwned)
{
    Trace trace;
    auto owned = std::make_unique<TracingListener>(trace);
    TracingListener* const listener = owned.get();
    home->addOwnedConstellationListener(std::move(owned));

    home->removeConstellationListener(listener);

    EXPECT_THAT(trace, ElementsAre("listener removed", "listener gone"));
}

TEST_F(AConstellationListener, IsRemovedOnceForEachTimeItWasAdded)
{
    Trace trace;
    TracingListener listener(trace);
    home->addConstellationListener(&listener);
    home->addConstellationListener(&listener);

    home->removeConstellationListener(&listener);
    Model const model = Model::create(home);
    home->removeConstellationListener(&listener);
    home->removeConstellationListener(&listener);

    EXPECT_THAT(trace, ElementsAre("listener removed", "listener added", "listener removed"));
}

TEST_F(AConstellationListener, IsToldOfTheEndOfItsConstellation)
{
    Trace trace;
    {
        ModelConstellation const shortLived = ModelConstellation::create();
        shortLived->addOwnedConstellationListener(std::make_unique<TracingListener>(trace));
        Model::create(shortLived);
    }

    EXPECT_THAT(trace, ElementsAre("listener added", "listener destroyed", "listener removed",
                                   "listener gone"));
}

// ---------------------------------------------------------------------------- while they are told

/// Three listeners of which the second does something when it is told.
class AConstellationListenerThatIsTold : public AConstellationListener
{
protected:
    AConstellationListenerThatIsTold()
    {
        for (TracingListener* const listener : {&first, &second, &third})
            home->addConstellationListener(listener);
    }
    ~AConstellationListenerThatIsTold() override
    {
        for (TracingListener* const listener : {&first, &second, &third, &late})
            home->removeConstellationListener(listener);
    }

    Trace trace;
    TracingListener first{trace, "first"}, second{trace, "second"}, third{trace, "third"};
    TracingListener late{trace, "late"};
};

TEST_F(AConstellationListenerThatIsTold, MayRemoveItself)
{
    second.onAdded = [&](auto const&...) { home->removeConstellationListener(&second); };

    Model const model = Model::create(home);

    EXPECT_THAT(trace, ElementsAre("first added", "second added", "second removed", "third added"));
    trace.clear();
    model->destroy();
    EXPECT_THAT(trace, ElementsAre("first destroyed", "third destroyed"));
}

TEST_F(AConstellationListenerThatIsTold, MayRemoveTheOneBehindIt)
{
    second.onDestroyed = [&](auto const&...) { home->removeConstellationListener(&third); };
    Model const model = Model::create(home);
    trace.clear();

    model->destroy();

    EXPECT_THAT(trace, ElementsAre("first destroyed", "second destroyed", "third removed"));
}

TEST_F(AConstellationListenerThatIsTold, MayRemoveAllAndAddAnother)
{
    second.onAdded = [&](auto const&...) {
        for (TracingListener* const listener : {&third, &second, &first})
            home->removeConstellationListener(listener);
        home->addConstellationListener(&late);
    };

    Model const model = Model::create(home);

    EXPECT_THAT(trace, ElementsAre("first added", "second added", "third removed", "second removed",
                                   "first removed", "late added"));
}

TEST_F(AConstellationListenerThatIsTold, MayAddAModelAndThenRemoveTheOneBehindIt)
{
    Model inner;
    second.onAdded = [&](auto const&...) {
        if (inner)
            return;
        inner = Model::createTransientModel();
        inner = Model::create(home);
        home->removeConstellationListener(&third);
    };

    Model const model = Model::create(home);

    EXPECT_THAT(trace, ElementsAre("first added", "second added", "first added", "second added",
                                   "third added", "third removed"));
}

TEST_F(AConstellationListenerThatIsTold, MayFailAndLeaveTheListUsable)
{
    second.onAdded = [](auto const&...) { throw std::runtime_error("no"); };
    EXPECT_THROW(Model::create(home), std::runtime_error);
    second.onAdded = nullptr;
    trace.clear();

    Model const model = Model::create(home);
    home->removeConstellationListener(&first);

    EXPECT_THAT(trace, ElementsAre("first added", "second added", "third added", "first removed"));
}

TEST_F(AConstellationListenerThatIsTold, MayRemoveTheOthersWhenItIsRemovedAtTheEnd)
{
    class Remover : public TracingListener
    {
    public:
        using TracingListener::TracingListener;

        void listenerRemoved(ModelConstellation const& constellation) override
        {
            TracingListener::listenerRemoved(constellation);
            constellation->removeConstellationListener(other);
        }

        ConstellationListener* other = nullptr;
    };
    TracingListener other(trace, "other");
    Remover remover(trace, "remover");
    remover.other = &other;
    {
        ModelConstellation const shortLived = ModelConstellation::create();
        shortLived->addConstellationListener(&remover);
        shortLived->addConstellationListener(&other);
    }

    EXPECT_THAT(trace, ElementsAre("remover removed", "other removed"));
}
}  // namespace
