// Whatever fails, and whenever: a model is afterwards as it was before the transaction or as the
// transaction wanted it, nothing leaks, and the next transaction finds it usable.
#include "tarnkiln/kernel/AbstractTransactionImpl.h"
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/meta/DataModelUsageProvider.h"
#include "tarnkiln/meta/Package.h"
#include "tests/support/EachFailure.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodePicture.h"
#include "tests/support/PlainElement.h"
#include "tests/support/ScriptedListener.h"

#include <new>

namespace {

using namespace testkit;
using testing::IsEmpty;
using Picture = std::vector<std::string>;

/// Two models with elements that are tied in all ways, and listeners for everything.
class World
{
public:
    World()
    {
        for (ScriptedListener* const listener : {&ofModel, &alsoOfModel, &ofOther})
            listener->keepsReports = false;
        root = make("root");
        other = make("other");
        a = make("a");
        b = make("b");
        c = make("c");
        d = make("d");
        leaf = make("leaf");
        part = make("part");
        named = make("named");
        named->setName(u"named");
        root->getChildren().push_back(a);
        root->getChildren().push_back(b);
        a->getChildren().push_back(leaf);
        root->getParts().push_back(part);
        root->setCore(c);
        root->setBody(d);
        other->getByName().insert(named);
        a->setLeft(b);
        c->setLeft(d);
        a->setOwner(root);
        a->getLinks().push_back(b);
        b->getLinks().push_back(leaf);
        a->getMarks().insert(leaf);
        b->setGroup(other);
        b->setBuddy(leaf);
        a->setName(u"a name that is too long to be kept in place");
        a->setNote(ustring(u"a note that is too long to be kept in place"));
        a->getNumbers().push_back(1);
        a->getLabels().push_back(u"label");
        a->getWords().insert(u"word");
        elsewhere = Model::create(constellation);
        Transaction const setUp = elsewhere->beginTransaction(/*revertible=*/true);
        far = Node::create(elsewhere);
        far->setTag("far");
        setUp.commit();
        listen(model, ofModel);
        listen(model, alsoOfModel);
        listen(elsewhere, ofOther);
    }

    Node make(std::string const& tag)
    {
        Node const node = Node::create(model);
        node->setTag(tag);
        return node;
    }
    Transaction begin() const { return model->beginTransaction(/*revertible=*/true); }
    /// Both models, which must be consistent.
    Picture picture() const
    {
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        EXPECT_THAT(elsewhere->checkInvariants(), IsEmpty());
        Picture result = pictureOf(model);
        Picture const second = pictureOf(elsewhere);
        result.insert(result.end(), second.begin(), second.end());
        return result;
    }
    /// Makes a change in a transaction, which must succeed and be taken back.
    void expectUsable() const
    {
        EXPECT_EQ(nullptr, model->getCurrentTransaction());
        EXPECT_EQ(nullptr, elsewhere->getCurrentTransaction());
        EXPECT_EQ(nullptr, constellation->getTransactionGroup());
        EXPECT_FALSE(model->isFrozen());
        Picture const before = picture();
        Transaction const transaction = begin();
        far->setCount(far->getCount() + 1);
        Node::create(model)->setTag("probe");
        EXPECT_EQ(TransactionResult::RolledBack, transaction.rollBack());
        EXPECT_EQ(before, picture());
    }

    ModelConstellation const constellation = ModelConstellation::create();
    Model const model = Model::create(constellation);
    Model elsewhere;
    Node root, other, a, b, c, d, leaf, part, named, far;
    ScriptedListener ofModel, alsoOfModel, ofOther;
};

/// Makes a node in a transaction of its own.
void createIn(Model const& model)
{
    Transaction const transaction = model->beginTransaction(/*revertible=*/false);
    Node::create(model);
    transaction.commit();
}

/// Builds an element with two others in it.
void build(Model const& model)
{
    Plain::Builder root(model);
    root.setValue(1);
    for (int i = 0; i < 2; ++i)
        root.addChild(std::make_unique<Plain::Builder>());
    root.create();
}

/// One public call.
struct Operation
{
    char const* name;
    void (*run)(World& world);
};

void PrintTo(Operation const& operation, std::ostream* out)
{
    *out << operation.name;
}

Operation const OPERATIONS[] = {
    {"SetANumber", [](World& w) { w.a->setCount(7); }},
    {"SetAText", [](World& w) { w.a->setName(u"another name that is too long to be kept"); }},
    {"SetAnOptionalText",
     [](World& w) { w.b->setNote(ustring(u"another note that is too long to be kept")); }},
    {"RenameAKeyedElement",
     [](World& w) { w.named->setName(u"a new name, and a long one at that"); }},
    {"RenameAGroupedElement",
     [](World& w) { w.b->setName(u"a new name, and a long one at that"); }},
    {"AddANumber", [](World& w) { w.a->getNumbers().push_back(2); }},
    {"AddALabel",
     [](World& w) { w.a->getLabels().push_back(u"a label too long to keep in place"); }},
    {"ClearLabels", [](World& w) { w.a->getLabels().clear(); }},
    {"AddAWord", [](World& w) { w.a->getWords().insert(u"a word too long to be kept in place"); }},
    {"SetAReference", [](World& w) { w.a->setBuddy(w.other); }},
    {"SetOneToOne", [](World& w) { w.a->setLeft(w.d); }},
    {"SetOneToOneFromTheOtherEnd", [](World& w) { w.b->setRight(w.c); }},
    {"ClearOneToOne", [](World& w) { w.a->setLeft(Node()); }},
    {"AddToOneToMany", [](World& w) { w.other->getOwned().push_back(w.a); }},
    {"SetTheOwnerOfOneToMany", [](World& w) { w.a->setOwner(w.other); }},
    {"RemoveFromOneToMany", [](World& w) { w.root->getOwned().remove(w.a); }},
    {"AddToManyToMany", [](World& w) { w.a->getLinks().push_back(w.leaf); }},
    {"InsertIntoManyToMany", [](World& w) { w.leaf->getBacklinks().insert(0, w.root); }},
    {"ReplaceInManyToMany", [](World& w) { w.a->getLinks().replace(0, w.c); }},
    {"ClearManyToMany", [](World& w) { w.b->getLinks().clear(); }},
    {"AddToASet", [](World& w) { w.a->getMarks().insert(w.b); }},
    {"EraseFromASet", [](World& w) { w.a->getMarks().erase(w.leaf); }},
    {"MoveAChildByItsContainer", [](World& w) { w.other->getChildren().push_back(w.a); }},
    {"MoveAChildByItself", [](World& w) { w.a->setParent(w.other); }},
    {"ReleaseAChild", [](World& w) { w.a->setParent(Node()); }},
    {"ContainATopLevelElement", [](World& w) { w.leaf->getChildren().push_back(w.other); }},
    {"MoveAPart", [](World& w) { w.other->getParts().push_back(w.part); }},
    {"ReleaseAPart", [](World& w) { w.root->getParts().remove(w.part); }},
    {"ReplaceTheCore", [](World& w) { w.root->setCore(w.part); }},
    {"ReplaceTheBody", [](World& w) { w.root->setBody(w.leaf); }},
    {"SetTheHost", [](World& w) { w.leaf->setHost(w.root); }},
    {"MoveIntoAMap", [](World& w) { w.other->getByName().insert(w.leaf); }},
    {"LeaveAMap", [](World& w) { w.named->setScope(Node()); }},
    {"MoveIntoAMultimap", [](World& w) { w.root->getGrouped().insert(w.b); }},
    {"Create", [](World& w) { createIn(w.model); }},
    {"Build", [](World& w) { build(w.model); }},
    {"DestroyALeaf", [](World& w) { w.leaf->destroy(); }},
    {"DestroyATree", [](World& w) { w.root->destroy(); }},
    {"DestroyAMapWithItsContents", [](World& w) { w.other->destroy(); }},
    {"DestroyAllContents", [](World& w) { w.model->destroyAllContents(); }},
    {"ChangeAnotherModel", [](World& w) { w.far->setCount(5); }},
    {"CreateInAnotherModel", [](World& w) { createIn(w.elsewhere); }},
};

/// What the world looks like before and after an operation that nothing disturbs.
struct Outcome
{
    explicit Outcome(Operation const& operation)
    {
        World world;
        before = world.picture();
        Transaction const transaction = world.begin();
        operation.run(world);
        EXPECT_EQ(TransactionResult::Committed, transaction.commit());
        after = world.picture();
    }

    Picture before;
    Picture after;
};

class OutOfMemory : public testing::TestWithParam<Operation>
{
protected:
    Operation const operation = GetParam();
    Outcome const outcome{operation};
};

INSTANTIATE_TEST_SUITE_P(Operations, OutOfMemory, testing::ValuesIn(OPERATIONS),
                         testing::PrintToStringParamName());

TEST_P(OutOfMemory, WhileAChangeIsMadeInATransactionIsTakenBackByIt)
{
    auto const round = [&](unsigned long number, Failing mode) {
        World world;
        Transaction const transaction = world.begin();
        Attempt const attempt(number, mode, [&] { operation.run(world); });
        if (attempt.threw)
            transaction.rollBack();
        else
            transaction.commit();
        EXPECT_EQ(attempt.threw ? outcome.before : outcome.after, world.picture());
        world.expectUsable();
        return attempt.failed;
    };
    forEachFailure(round, {Failing::Once});
}

TEST_P(OutOfMemory, WhileAChangeIsMadeOnItsOwnLeavesTheModelAsItWasOrIsTaken)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        Attempt const attempt(number, mode, [&] { operation.run(world); });
        Picture const result = world.picture();
        if (attempt.threw)
            EXPECT_EQ(outcome.before, result);
        else
            EXPECT_THAT(result, testing::AnyOf(outcome.before, outcome.after));
        world.expectUsable();
        return attempt.failed;
    });
}

TEST_P(OutOfMemory, WhileATransactionCommitsLeavesTheModelAsItWasOrCommitted)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        Transaction const transaction = world.begin();
        operation.run(world);
        TransactionResult result = TransactionResult::NotCompleted;
        Attempt const attempt(number, mode, [&] { result = transaction.commit(); });
        EXPECT_FALSE(attempt.threw);
        EXPECT_THAT(result,
                    testing::AnyOf(TransactionResult::Committed, TransactionResult::RolledBack));
        EXPECT_EQ(result == TransactionResult::Committed ? outcome.after : outcome.before,
                  world.picture());
        world.expectUsable();
        return attempt.failed;
    });
}

TEST_P(OutOfMemory, WhileATransactionIsRolledBackLeavesTheModelAsItWas)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        Transaction const transaction = world.begin();
        operation.run(world);
        TransactionResult result = TransactionResult::NotCompleted;
        Attempt const attempt(number, mode, [&] { result = transaction.rollBack(); });
        EXPECT_FALSE(attempt.threw);
        EXPECT_EQ(TransactionResult::RolledBack, result);
        EXPECT_EQ(outcome.before, world.picture());
        world.expectUsable();
        return attempt.failed;
    });
}

TEST(OutOfMemoryWhileATransactionBegins, LeavesNoneOpen)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        Picture const before = world.picture();
        Attempt const attempt(number, mode, [&] { world.begin(); });
        EXPECT_EQ(before, world.picture());
        world.expectUsable();
        return attempt.failed;
    });
}

TEST(OutOfMemoryWhileATransactionBegins, LeavesTheOuterOneUsable)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        Transaction const outer = world.begin();
        Attempt const attempt(number, mode, [&] { world.begin().commit(); });
        world.a->setCount(3);
        EXPECT_EQ(TransactionResult::Committed, outer.commit());
        EXPECT_EQ(3, world.a->getCount());
        world.expectUsable();
        return attempt.failed;
    });
}

// ---------------------------------------------------------------------------- callbacks

/// Fails when it is told for a given time.
class FailingUsageProvider : public meta::DataModelUsageProvider
{
public:
    FailingUsageProvider(int number, bool& failed) : m_remaining(number), m_failed(failed) {}

    std::vector<meta::Package> getUsedPackages() const override { return {}; }
    void elementCreated(ModelElement::Impl*) override { call(); }
    void elementDestroying(ModelElement::Impl*) override { call(); }

private:
    void call()
    {
        if (--m_remaining != 0)
            return;
        m_failed = true;
        throw std::runtime_error("the usage provider fails");
    }

    int m_remaining;
    bool& m_failed;
};

class FailingCallback : public testing::TestWithParam<Operation>
{
protected:
    ~FailingCallback() override
    {
        EXPECT_EQ(nodes, Node::liveCount());
        EXPECT_EQ(plain, Plain::Impl::inMemory);
    }

    /// Whether the operation fails by the callback.
    bool fails(World& world) const
    {
        try
        {
            GetParam().run(world);
        }
        catch (std::runtime_error const&)
        {
            return true;
        }
        return false;
    }

    long const nodes = Node::liveCount();
    long const plain = Plain::Impl::inMemory;
};

INSTANTIATE_TEST_SUITE_P(Operations, FailingCallback, testing::ValuesIn(OPERATIONS),
                         testing::PrintToStringParamName());

TEST_P(FailingCallback, OfTheUsageProviderIsTakenBackByTheTransaction)
{
    bool failed = true;
    for (int number = 1; failed; ++number)
    {
        SCOPED_TRACE("call " + std::to_string(number));
        World world;
        Picture const before = world.picture();
        failed = false;
        world.model->setUsageProvider(std::make_unique<FailingUsageProvider>(number, failed));
        Transaction const transaction = world.begin();
        EXPECT_EQ(fails(world), failed);
        world.model->setUsageProvider(nullptr);
        transaction.rollBack();
        EXPECT_EQ(before, world.picture());
        if (failed)
            world.expectUsable();
    }
}

TEST_P(FailingCallback, OfTheFirstChangeLeavesEverythingAsItWas)
{
    World world;
    Picture const before = world.picture();
    Transaction const transaction = world.begin();
    transaction.addFirstChangeCallback([] { throw std::runtime_error("no change, please"); });
    if (fails(world))
    {
        EXPECT_EQ(before, world.picture());
    }
    transaction.rollBack();
    EXPECT_EQ(before, world.picture());
    world.expectUsable();
}

// ---------------------------------------------------------------------------- listeners

enum class Phase
{
    Prepare,
    Validate,
    Committed,
    RolledBack
};

/// Lets the call with that number, over all listeners of the world, throw in the phase.
struct ThrowingListeners
{
    ThrowingListeners(World& world, Phase phase, int number) : remaining(number)
    {
        for (ScriptedListener* const listener :
             {&world.ofModel, &world.alsoOfModel, &world.ofOther})
        {
            switch (phase)
            {
            case Phase::Prepare:
                listener->onPrepare = [this](Report const&) { call(); };
                break;
            case Phase::Validate:
                listener->onValidate = [this](Report const&) {
                    call();
                    return true;
                };
                break;
            case Phase::Committed:
                listener->onCommitted = [this](Report const&) { call(); };
                break;
            case Phase::RolledBack:
                listener->onRolledBack = [this](bool, Report const&) { call(); };
                break;
            }
        }
    }
    void call()
    {
        ++calls;
        if (--remaining == 0)
            throw std::runtime_error("a listener fails");
    }

    int remaining;
    int calls = 0;
};

class FailingListener : public testing::TestWithParam<Phase>
{};

INSTANTIATE_TEST_SUITE_P(Phases, FailingListener,
                         testing::Values(Phase::Prepare, Phase::Validate, Phase::Committed,
                                         Phase::RolledBack));

TEST_P(FailingListener, LeavesTheModelAsItWasOrCommittedAtWhicheverCallItFails)
{
    Phase const phase = GetParam();
    bool const rollsBack = phase == Phase::Prepare || phase == Phase::Validate;
    Operation const both = {"Both", [](World& w) {
                                w.root->destroy();
                                w.far->setCount(3);
                                w.make("created");
                            }};
    Outcome const outcome(both);
    int lastCalls = 0;
    for (int number = 1; number <= 4; ++number)
    {
        SCOPED_TRACE("call " + std::to_string(number));
        long const nodes = Node::liveCount();
        {
            World world;
            ThrowingListeners listeners(world, phase, number);
            Transaction const transaction = world.begin();
            both.run(world);
            TransactionResult const result =
                phase == Phase::RolledBack ? transaction.rollBack() : transaction.commit();
            bool const undone = phase == Phase::RolledBack || (rollsBack && number <= 3);

            EXPECT_EQ(undone ? TransactionResult::RolledBack : TransactionResult::Committed,
                      result);
            EXPECT_EQ(undone ? outcome.before : outcome.after, world.picture());
            EXPECT_EQ(rollsBack ? std::min(number, 3) : 3, listeners.calls);
            lastCalls = listeners.calls;
            listeners.remaining = 0;
            world.expectUsable();
        }
        EXPECT_EQ(nodes, Node::liveCount());
    }
    EXPECT_EQ(3, lastCalls) << "all three listeners are called when none fails";
}
}  // namespace
