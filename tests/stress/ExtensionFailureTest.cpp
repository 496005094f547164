// Values of extensions when memory runs out: they are as they were or as they were to be, nothing
// leaks, and the next change finds them usable.
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/EachFailure.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/ScriptedListener.h"

#include <new>

namespace {

using namespace testkit;
using meta::StandardTypes;
using testing::IsEmpty;
using Picture = std::vector<std::string>;

constexpr std::uint32_t MANY = 0xFFFFFFFF;

Value number(int payload)
{
    return Value(StandardTypes::integerMeta, payload);
}

void extend(Model const& model, ustring const& name, ustring const& type, std::uint32_t upper,
            boost::optional<Value> const& byDefault)
{
    meta::ExtensionPrototype prototype;
    prototype.setName(name);
    prototype.setTypeName(type);
    prototype.setUpper(upper);
    prototype.setIsOrdered(true);
    model->extendMetaclass(Node::metaClass(), prototype, byDefault);
}

AbstractPrimitiveCollection& pagesOf(Node const& node)
{
    return node->getExtension(u"pages").getValue<AbstractPrimitiveCollection&>();
}

/// A model that extends the class of its elements, and an empty one to move them to.
class World
{
public:
    explicit World(bool withListener = true)
    {
        StandardTypes::ensureInitialized();
        extend(model, u"shelf", u"Integer", 1, number(0));
        extend(model, u"friend", Node::metaClass()->getQualifiedName(), 1, boost::none);
        extend(model, u"pages", u"Integer", MANY, boost::none);
        extend(target, u"pages", u"Integer", MANY, boost::none);
        set = Node::create(model);
        unset = Node::create(model);
        child = Node::create(model);
        set->getChildren().push_back(child);
        set->setExtension(u"shelf", number(1));
        set->setExtension(u"friend", Value(Node::metaClass(), unset));
        child->setExtension(u"shelf", number(2));
        for (int page = 1; page <= 3; ++page)
            pagesOf(set).genericAdd(number(page));
        listener.keepsReports = false;
        if (withListener)
            listen(model, listener);
    }

    /// What can be seen of the elements, without making any collection.
    Picture picture() const
    {
        EXPECT_THAT(model->checkInvariants(), IsEmpty());
        EXPECT_THAT(target->checkInvariants(), IsEmpty());
        Picture result;
        for (Node const& node : {set, unset, child})
        {
            if (!node)
            {
                result.push_back("dead");
                continue;
            }
            std::string line = node->getModel() == model ? "here" : "there";
            line += " shelf=" + std::to_string(node->getExtension(u"shelf").getValue<int>());
            bool const isSet = node->hasNonDefaultExtension(u"friend");
            line += isSet ? " has a friend" : "";
            if (node->hasNonDefaultExtension(u"pages"))
            {
                for (Value const& page : pagesOf(node).getAllValues())
                    line += ' ' + std::to_string(page.getValue<int>());
            }
            result.push_back(line);
        }
        result.push_back(std::to_string(model->getElementCount()) + " elements");
        return result;
    }
    void expectUsable() const
    {
        EXPECT_EQ(nullptr, model->getCurrentTransaction());
        Picture const before = picture();
        Node const probe = Node::create(target);
        probe->destroy();
        Transaction const transaction = model->beginTransaction(/*revertible=*/true);
        for (Node const& node : {set, unset})
        {
            if (node && node->getModel() == model)
            {
                node->setExtension(u"shelf", number(77));
                pagesOf(node).genericAdd(number(77));
            }
        }
        transaction.rollBack();
        EXPECT_EQ(before, picture());
    }

    Model const model = Model::create(ModelConstellation());
    Model const target = Model::create(ModelConstellation());
    Node set, unset, child;
    ScriptedListener listener;
};

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
    {"SetTheFirstValue", [](World& w) { w.unset->setExtension(u"shelf", number(5)); }},
    {"SetAnotherValue", [](World& w) { w.set->setExtension(u"shelf", number(5)); }},
    {"SetAFirstReference",
     [](World& w) { w.unset->setExtension(u"friend", Value(Node::metaClass(), w.unset)); }},
    {"Reset", [](World& w) { w.set->setExtension(u"shelf", number(0)); }},
    {"AddToACollection", [](World& w) { pagesOf(w.set).genericAdd(number(4)); }},
    {"AddToANewCollection", [](World& w) { pagesOf(w.unset).genericAdd(number(4)); }},
    {"ClearACollection", [](World& w) { pagesOf(w.set).clear(); }},
    {"Destroy", [](World& w) { w.set->destroy(); }},
};

struct Outcome
{
    explicit Outcome(Operation const& operation)
    {
        World world;
        before = world.picture();
        operation.run(world);
        after = world.picture();
        EXPECT_NE(before, after);
    }

    Picture before;
    Picture after;
};

class ExtensionsOutOfMemory : public testing::TestWithParam<Operation>
{
protected:
    Operation const operation = GetParam();
    Outcome const outcome{operation};
};

INSTANTIATE_TEST_SUITE_P(Operations, ExtensionsOutOfMemory, testing::ValuesIn(OPERATIONS),
                         testing::PrintToStringParamName());

/// Whether `call` failed for want of memory.
template <class Call> bool runsOut(Call const& call)
{
    try
    {
        call();
    }
    catch (std::bad_alloc const&)
    {
        return true;
    }
    return false;
}

TEST_P(ExtensionsOutOfMemory, InATransactionComeBackWithIt)
{
    auto const round = [&](unsigned long number, Failing mode) {
        World world;
        bool failed = false;
        bool threw = false;
        {
            Transaction const transaction = world.model->beginTransaction(/*revertible=*/true);
            {
                FailingAllocation const failing(number, mode);
                threw = runsOut([&] { operation.run(world); });
                failed = failing.hasFailed();
            }
            if (threw)
                transaction.rollBack();
            else
                transaction.commit();
        }
        EXPECT_EQ(threw ? outcome.before : outcome.after, world.picture());
        world.expectUsable();
        return failed;
    };
    forEachFailure(round, {Failing::Once});
}

TEST_P(ExtensionsOutOfMemory, OnTheirOwnAreAsBeforeOrAsWanted)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        bool failed = false;
        bool threw = false;
        {
            FailingAllocation const failing(number, mode);
            threw = runsOut([&] { operation.run(world); });
            failed = failing.hasFailed();
        }
        Picture const result = world.picture();
        if (threw)
            EXPECT_EQ(outcome.before, result);
        else
            EXPECT_THAT(result, testing::AnyOf(outcome.before, outcome.after));
        world.expectUsable();
        return failed;
    });
}

TEST_P(ExtensionsOutOfMemory, WhileATransactionIsRolledBackComeBackAllTheSame)
{
    forEachFailure([&](unsigned long number, Failing mode) {
        World world;
        Transaction const transaction = world.model->beginTransaction(/*revertible=*/true);
        operation.run(world);
        TransactionResult result = TransactionResult::NotCompleted;
        bool failed = false;
        {
            FailingAllocation const failing(number, mode);
            result = transaction.rollBack();
            failed = failing.hasFailed();
        }
        EXPECT_EQ(TransactionResult::RolledBack, result);
        EXPECT_EQ(outcome.before, world.picture());
        world.expectUsable();
        return failed;
    });
}

/// The registry's listener keeps the last report, which must be of the same size after each round.
struct SameLastReport
{
    SameLastReport() = default;
    SameLastReport(SameLastReport const&) = delete;
    SameLastReport& operator=(SameLastReport const&) = delete;
    ~SameLastReport()
    {
        Model const model = Model::create(ModelConstellation());
        extend(model, u"shelf", u"Integer", 1, number(0));
        model->destroy();
    }
};

TEST(ContentsThatMoveOutOfMemory, AreAllHereOrAllThere)
{
    Picture here, there;
    {
        World world(/*withListener=*/false);
        here = world.picture();
        world.model->moveAllContentsTo(world.target);
        there = world.picture();
        EXPECT_EQ(world.target->getElementCount(), 3u);
    }
    auto const round = [&](unsigned long number, Failing mode) {
        SameLastReport const last;
        World world(/*withListener=*/false);
        bool failed = false;
        bool threw = false;
        {
            FailingAllocation const failing(number, mode);
            threw = runsOut([&] { world.model->moveAllContentsTo(world.target); });
            failed = failing.hasFailed();
        }
        Picture const result = world.picture();
        if (threw)
            EXPECT_THAT(result, testing::AnyOf(here, there))
                << "what follows the move may fail too";
        else
            EXPECT_EQ(result, there);
        world.expectUsable();
        return failed;
    };
    forEachFailure(round, {Failing::Once});
}
}  // namespace
