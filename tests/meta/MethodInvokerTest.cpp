#include "tests/meta/CallsByReflection.h"

#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"

#include <boost/optional/optional_io.hpp>

namespace testkit {

using meta::Operation;
using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

namespace {

/// Does as it is told, and tells when it goes.
class ScriptedInvoker : public meta::AbstractMethodInvoker
{
public:
    explicit ScriptedInvoker(
        std::function<void(ModelElement const&)> run = [](auto const&) {}, bool* gone = nullptr)
        : m_run(std::move(run)),
          m_gone(gone)
    {}
    ~ScriptedInvoker() override
    {
        if (m_gone)
            *m_gone = true;
    }
    boost::optional<Value> invoke(ModelElement const& self,
                                  std::vector<Value> const&) const override
    {
        m_run(self);
        return boost::none;
    }

private:
    std::function<void(ModelElement const&)> const m_run;
    bool* const m_gone;
};
}  // namespace

// ---------------------------------------------------------------------------- what can be called

TEST_F(CallsByReflection, GiveTheResultOfTheMethod)
{
    Operation const subtract = declareMethod(&Machine::subtract, typeOf<int>());

    auto const result = invoke(make<Machine>(), subtract, {value(7), value(2)});

    ASSERT_TRUE(result);
    EXPECT_EQ(result->getValue<int>(), 5);
    EXPECT_EQ(result->getFlags(), ValueFlags::Single);
    EXPECT_EQ(result->getType(), typeOf<int>());
}

TEST_F(CallsByReflection, GiveNothingForAMethodWithoutResult)
{
    Operation const call = declareMethod(&Machine::call);
    Node const machine = make<Machine>();

    EXPECT_FALSE(invoke(machine, call, {text(u"mill")}));

    EXPECT_EQ(machine->getName(), u"mill");
}

TEST_F(CallsByReflection, ReachTheOverrideOfAVirtualMethod)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<ustring>());

    EXPECT_EQ(invoke(make<Machine>(), speak)->getValue<ustring>(), u"machine");
    EXPECT_EQ(invoke(make<LoudMachine>(), speak)->getValue<ustring>(), u"MACHINE");
}

TEST_F(CallsByReflection, WorkOnElementsOfSubclasses)
{
    Operation const getCount = declareMethod(&Node::Impl::getCount, typeOf<int>());
    SpecialNode const special = SpecialNode::create(m_model);
    special->setCount(9);

    EXPECT_EQ(invoke(special, getCount)->getValue<int>(), 9);
}

TEST_F(CallsByReflection, RunWhateverTheFlagsOfTheOperation)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<ustring>());
    change([&] {
        speak->setIsAbstract(true);
        speak->setIsStatic(true);
        speak->setIsEvent(true);
        speak->setLower(3);
        speak->setUpper(5);
    });

    EXPECT_EQ(invoke(make<Machine>(), speak)->getValue<ustring>(), u"machine");
}

TEST_F(CallsByReflection, RefuseAnEmptyOperation)
{
    EXPECT_RAISES_WITH(messages::NoSuchOperation, invoke(make<Machine>(), Operation()), u"",
                       Node::metaClass()->getQualifiedName());
}

TEST_F(CallsByReflection, RefuseADestroyedOperationByItsName)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<ustring>());
    change([&] { speak->destroy(); });

    EXPECT_RAISES_WITH(messages::NoSuchOperation, invoke(make<Machine>(), speak), u"run",
                       Node::metaClass()->getQualifiedName());
}

TEST_F(CallsByReflection, RefuseAnOperationWithoutInvoker)
{
    Operation const nothing = declare(nullptr);

    EXPECT_RAISES_WITH(messages::NoSuchOperation, invoke(make<Machine>(), nothing), u"run",
                       Node::metaClass()->getQualifiedName());
}

TEST_F(CallsByReflection, RefuseAnOperationThatTheClassHasNotGot)
{
    Operation const ofSubclass =
        declareMethod(&Machine::speak, typeOf<ustring>(), SpecialNode::metaClass());
    Operation const ofNobody = declareMethod(&Machine::speak, typeOf<ustring>(), {});

    EXPECT_RAISES_WITH(messages::NoSuchOperation, invoke(make<Machine>(), ofSubclass), u"run",
                       Node::metaClass()->getQualifiedName());
    EXPECT_RAISES_WITH(messages::NoSuchOperation, invoke(make<Machine>(), ofNobody), u"run",
                       Node::metaClass()->getQualifiedName());
}

TEST_F(CallsByReflection, NameTheClassOfTheElementWhenTheyAreRefused)
{
    EXPECT_RAISES_WITH(messages::NoSuchOperation,
                       invoke(SpecialNode::create(m_model), declare(nullptr)), u"run",
                       SpecialNode::metaClass()->getQualifiedName());
}

TEST_F(CallsByReflection, NeedARightForWhatIsNotPublic)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<ustring>());
    change([&] { speak->setIsPublic(false); });
    Node const machine = make<Machine>();

    EXPECT_RAISES_WITH(messages::NoSuchOperation, invoke(machine, speak), u"run",
                       Node::metaClass()->getQualifiedName());
    EXPECT_TRUE(machine->invoke(speak, {}, ModelElement::Impl::PRIVILEGED_ACCESS));
    EXPECT_TRUE(machine->invoke(speak, {}, ModelElement::Impl::NO_PROXY_RESOLVE));
    EXPECT_TRUE(machine->invoke(speak, {}, ModelElement::Impl::IN_MEMORY_ONLY));
}

// ---------------------------------------------------------------------------- arguments

TEST_F(CallsByReflection, RefuseTooFewAndTooManyArguments)
{
    Operation const call = declareMethod(&Machine::call);
    Node const machine = make<Machine>();

    EXPECT_RAISES(messages::InvalidValue, invoke(machine, call));
    EXPECT_RAISES(messages::InvalidValue, invoke(machine, call, {text(u"a"), text(u"b")}));

    EXPECT_EQ(machine->getName(), u"");
}

TEST_F(CallsByReflection, RefuseAnElementThatHasNotTheMethod)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<ustring>());

    EXPECT_RAISES(messages::InvalidValue, invoke(Node::create(m_model), speak));
    EXPECT_RAISES(messages::InvalidValue, speak->getInvoker()->invoke(ModelElement(), {}));
}

TEST_F(CallsByReflection, CountTheArgumentsBeforeTheyLookAtThem)
{
    Operation const subtract = declareMethod(&Machine::subtract, typeOf<int>());

    EXPECT_RAISES(messages::InvalidValue, invoke(make<Machine>(), subtract, {text(u"one")}));
}

TEST_F(CallsByReflection, LookAtTheElementBeforeTheArguments)
{
    Operation const call = declareMethod(&Machine::call);

    EXPECT_RAISES(messages::InvalidValue, invoke(Node::create(m_model), call, {value(1)}));
}

TEST_F(CallsByReflection, FailForTheFirstArgumentThatDoesNotSuit)
{
    Operation const subtract = declareMethod(&Machine::subtract, typeOf<int>());
    Node const machine = make<Machine>();

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       invoke(machine, subtract, Arguments{text(u"a"), value(true)}), u"String");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       invoke(machine, subtract, Arguments{value(1), value(true)}), u"Boolean");
}

class TwoStepMachine : public Machine
{
public:
    using Machine::Machine;
    void callTwice(ustring const& name, int) { setName(name); }
};

TEST_F(CallsByReflection, ConvertAllArgumentsBeforeTheMethodRuns)
{
    Operation const callTwice = declareMethod(&TwoStepMachine::callTwice);
    Node const machine = make<TwoStepMachine>();

    EXPECT_RAISES(messages::CannotCastIncompatibleTypes,
                  invoke(machine, callTwice, {text(u"mill"), text(u"two")}));

    EXPECT_EQ(machine->getName(), u"");
}

enum class Speed
{
    SLOW = -1,
    FAST = 3
};

/// Takes and gives one thing of each kind that values can carry.
class Echo : public Machine
{
public:
    using Machine::Machine;

    Node node(Node const& argument) const { return argument; }
    ModelElement element(ModelElement argument) const { return argument; }
    Model model(Model const& argument) const { return argument; }
    Speed speed(Speed argument) const { return argument; }
    boost::optional<int> rank(boost::optional<int> const& argument) const { return argument; }
    std::vector<ustring> texts(std::vector<ustring> const& argument) const { return argument; }
    std::set<int> numbers(std::set<int> const& argument) const { return argument; }
    std::vector<Operation> operations(std::vector<Operation> const& all) const { return all; }
    ustring const& name() const { return getName(); }
    std::size_t countMembers(ReferenceCollection& members) const
    {
        return members.getAllValues().size();
    }
    void throwFive() { throw 5; }
};

TEST_F(CallsByReflection, CarryElements)
{
    Operation const node = declareMethod(&Echo::node, Node::metaClass());
    Node const given = Node::create(m_model);

    auto const result = invoke(make<Echo>(), node, {Value(Node::metaClass(), given)});

    EXPECT_EQ(result->getValue<Node>(), given);
}

TEST_F(CallsByReflection, GiveElementsTheirOwnClass)
{
    Operation const node = declareMethod(&Echo::node, Node::metaClass());
    Operation const element = declareMethod(&Echo::element, ModelElement::metaClass());
    SpecialNode const given = SpecialNode::create(m_model);
    Value const argument(Node::metaClass(), Node(given));

    EXPECT_EQ(invoke(make<Echo>(), node, {argument})->getType(), SpecialNode::metaClass());
    EXPECT_EQ(invoke(make<Echo>(), element, {argument})->getType(), SpecialNode::metaClass());
}

TEST_F(CallsByReflection, GiveAnEmptyHandleTheTypeOfTheOperation)
{
    Operation const node = declareMethod(&Echo::node, SpecialNode::metaClass());

    auto const result = invoke(make<Echo>(), node, {Value(Node::metaClass(), Node())});

    ASSERT_TRUE(result);
    EXPECT_EQ(result->getType(), SpecialNode::metaClass());
    EXPECT_FALSE(result->getValue<ModelElement>().getElementImpl());
}

TEST_F(CallsByReflection, CarryModels)
{
    Operation const model = declareMethod(&Echo::model, Model::metaClass());

    auto const result = invoke(make<Echo>(), model, {Value(Model::metaClass(), m_model)});

    EXPECT_EQ(result->getValue<Model>(), m_model);
}

TEST_F(CallsByReflection, CarryLiteralsOfEnumerations)
{
    RegistryElement<meta::Enum> const speeds(u"SpeedOfTheTest");
    Operation const speed = declareMethod(&Echo::speed, speeds.get());
    Value const slow(speeds.get(), static_cast<long>(Speed::SLOW));

    auto const result = invoke(make<Echo>(), speed, {slow});

    EXPECT_EQ(*result, slow);
    EXPECT_EQ(result->getValue<long>(), -1);
}

TEST_F(CallsByReflection, CarryOptionalValues)
{
    Operation const rank = declareMethod(&Echo::rank, typeOf<int>());
    using Rank = boost::optional<int>;

    EXPECT_EQ(invoke(make<Echo>(), rank, {value(4)})->getValue<Rank>(), 4);
    EXPECT_EQ(invoke(make<Echo>(), rank, {Value(typeOf<int>(), Rank())})->getValue<Rank>(),
              boost::none);
}

TEST_F(CallsByReflection, CarryContainersOfValues)
{
    Operation const texts = declareMethod(&Echo::texts, typeOf<ustring>());
    Operation const numbers = declareMethod(&Echo::numbers, typeOf<int>());
    Value const words(typeOf<ustring>(), std::vector<ustring>{u"b", u"a"});
    Value const figures(typeOf<int>(), std::set<int>{3, 1});

    EXPECT_EQ(*invoke(make<Echo>(), texts, {words}), words);
    EXPECT_EQ(*invoke(make<Echo>(), numbers, {figures}), figures);
    EXPECT_EQ(invoke(make<Echo>(), texts, {words})->getFlags(), ValueFlags::Sequence);
    EXPECT_FALSE(invoke(make<Echo>(), texts, {words})->isManaged());
}

TEST_F(CallsByReflection, LendCollectionsOfElements)
{
    Operation const count = declareMethod(&Echo::countMembers, typeOf<unsigned long>());
    Node const machine = make<Echo>();
    machine->getChildren().push_back(Node::create(m_model));
    Value const children =
        machine->getPropertyValue(NodeMetamodel::get().properties[Node::Impl::CHILDREN.index],
                                  ModelElement::Impl::PUBLIC_ACCESS);

    EXPECT_EQ(invoke(machine, count, {children})->getValue<unsigned long>(), 1u);
}

TEST_F(CallsByReflection, CopyResultsThatAreReferences)
{
    Operation const name = declareMethod(&Echo::name, typeOf<ustring>());
    Node const machine = make<Echo>();
    machine->setName(u"mill");

    auto const result = invoke(machine, name);
    machine->setName(u"other");

    EXPECT_EQ(result->getValue<ustring>(), u"mill");
}

// ---------------------------------------------------------------------------- failures

TEST_F(CallsByReflection, FailIfTheResultIsNotOfTheTypeOfTheOperation)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<int>());
    Operation const untyped = declareMethod(&Machine::speak);
    Operation const node = declareMethod(&Echo::node, typeOf<ustring>());

    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, invoke(make<Machine>(), speak),
                       u"Integer");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes, invoke(make<Machine>(), untyped),
                       u"");
    EXPECT_RAISES_WITH(messages::CannotCastIncompatibleTypes,
                       invoke(make<Echo>(), node, Arguments{Value(Node::metaClass(), Node())}),
                       u"String");
}

TEST_F(CallsByReflection, LetExceptionsOfTheMethodPass)
{
    Operation const throwFive = declareMethod(&Echo::throwFive);

    EXPECT_THROW(invoke(make<Echo>(), throwFive), int);
}

TEST_F(CallsByReflection, PassFailuresOfTheModelUnchanged)
{
    Operation const call = declareMethod(&Machine::call);
    Node const machine = make<Machine>();
    Model::Freezer const freezer = m_model->freeze();

    EXPECT_RAISES(messages::ModelFrozen, invoke(machine, call, {text(u"mill")}));
}

// ---------------------------------------------------------------------------- installation

TEST_F(CallsByReflection, HandTheElementToInvokersOfAnyKind)
{
    ModelElement called;
    Operation const operation =
        declare(std::make_unique<ScriptedInvoker>([&](ModelElement const& on) { called = on; }));
    Node const node = Node::create(m_model);

    EXPECT_FALSE(invoke(node, operation));

    EXPECT_EQ(called, node);
}

TEST_F(CallsByReflection, KnowTheirOperationThroughTheInvoker)
{
    Operation const operation = declare(std::make_unique<ScriptedInvoker>());

    EXPECT_EQ(operation->getInvoker()->getOperation(), operation);
    EXPECT_FALSE(ScriptedInvoker().getOperation());
}

TEST_F(CallsByReflection, RunTheInvokerThatCameLast)
{
    bool isFirstGone = false;
    Operation const operation =
        declare(std::make_unique<ScriptedInvoker>([](auto const&) { FAIL(); }, &isFirstGone));

    operation->setInvoker(meta::makeInvoker(&Machine::speak));

    EXPECT_TRUE(isFirstGone);
    change([&] { operation->setType(typeOf<ustring>()); });
    EXPECT_EQ(invoke(make<Machine>(), operation)->getValue<ustring>(), u"machine");
}

TEST_F(CallsByReflection, MayTakeTheirOwnInvokerAway)
{
    bool isGone = false;
    Operation operation;
    auto const replace = [&](ModelElement const&) {
        operation->setInvoker(nullptr);
        EXPECT_FALSE(isGone);
    };
    operation = declare(std::make_unique<ScriptedInvoker>(replace, &isGone));
    Node const node = Node::create(m_model);

    invoke(node, operation);

    EXPECT_TRUE(isGone);
    EXPECT_RAISES(messages::NoSuchOperation, invoke(node, operation));
}

TEST_F(CallsByReflection, LeaveNoInvokerBehindWithoutItsOperation)
{
    bool isGone = false;
    Operation operation = Operation::create(Model::createRegistryModel(u"sketch"));
    operation->setInvoker(std::make_unique<ScriptedInvoker>([](auto const&) {}, &isGone));

    operation->destroy();
    EXPECT_FALSE(isGone);

    operation = Operation();
    EXPECT_TRUE(isGone);
}

TEST_F(CallsByReflection, WorkAgainWhenTheDestructionOfTheOperationIsTakenBack)
{
    Operation const speak = declareMethod(&Machine::speak, typeOf<ustring>());
    {
        RegistrySession session;
        speak->destroy();
        session.rollBack();
    }

    EXPECT_EQ(invoke(make<Machine>(), speak)->getValue<ustring>(), u"machine");
}

TEST_F(CallsByReflection, CountAsNoChangeOfTheRegistryWhenAnInvokerIsInstalled)
{
    Operation const operation = declare(nullptr);

    operation->setInvoker(std::make_unique<ScriptedInvoker>());  // under no lock, in a frozen model

    EXPECT_FALSE(invoke(Node::create(m_model), operation));
}
}  // namespace testkit
