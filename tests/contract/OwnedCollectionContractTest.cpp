// What holds for the collections of all kinds.
#include "tarnkiln/collections/ReflectiveElementMap.h"
#include "tarnkiln/collections/ReflectiveElementMultimap.h"
#include "tarnkiln/collections/ReflectiveElementSequence.h"
#include "tarnkiln/collections/ReflectiveUnorderedElementSet.h"
#include "tests/collections/CollectionFixture.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/RuntimeMetamodel.h"

#include <numeric>

namespace testkit {
namespace {

/// What has the collections of hand-written classes.
struct OfNode
{
    using Owner = Node;
    static constexpr bool IS_GIVEN_BY_SLOT = true;

    static Owner owner(Model const& model) { return Node::create(model); }
};

/// What has those of reflective elements. The class is that of nodes.
struct OfReflective
{
    using Owner = ModelElement;
    static constexpr bool IS_GIVEN_BY_SLOT = false;

    static Owner owner(Model const& model)
    {
        return ModelElement::createReflective(model, NodeMetamodel::get().node);
    }
};

/// A kind of collection: where its owner has it, what goes in, and what is in there.
/// `entry(model, i)` makes something to add; entries of different numbers differ.
template <class C> struct Values : OfNode
{
    using Collection = C;
    using Entry = typename C::value_type;
    using Contents = std::vector<Entry>;

    static Contents contents(C const& collection)
    {
        return Contents(collection.begin(), collection.end());
    }
};

struct Numbers : Values<PrimitiveSequence<int>>
{
    static Collection& of(Node const& node) { return node->getNumbers(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, false, Node::Impl::NUMBERS);
    }
    static Entry entry(Model const&, int number) { return number; }
    static void add(Collection& collection, Entry const& entry) { collection.push_back(entry); }
    static void remove(Collection& collection, Entry const& entry) { collection.remove(entry); }
};

template <class C> struct Texts : Values<C>
{
    static ustring entry(Model const&, int number)
    {
        return ustring(1, static_cast<char16_t>(u'a' + number));
    }
};

struct Labels : Texts<PrimitiveSequence<ustring>>
{
    static Collection& of(Node const& node) { return node->getLabels(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, true, Node::Impl::LABELS);
    }
    static void add(Collection& collection, Entry const& entry) { collection.push_back(entry); }
    static void remove(Collection& collection, Entry const& entry) { collection.remove(entry); }
};

struct Words : Texts<PrimitiveSet<ustring>>
{
    static Collection& of(Node const& node) { return node->getWords(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, Node::Impl::WORDS);
    }
    static void add(Collection& collection, Entry const& entry) { collection.insert(entry); }
    static void remove(Collection& collection, Entry const& entry) { collection.erase(entry); }
};

template <class C> struct ReferenceContents
{
    using Collection = C;
    using Contents = std::vector<ModelElement>;

    /// Sorted for a set, whose order says nothing.
    static Contents contents(C const& collection)
    {
        Contents result = collection.getAllValuesAndProxies();
        if (!collection.getGenericInterface()->isSequenceInterface())
            std::sort(result.begin(), result.end(), [](auto const& left, auto const& right) {
                return left.getImpl() < right.getImpl();
            });
        return result;
    }
};

template <class C> struct References : OfNode, ReferenceContents<C>
{
    using Entry = Node;

    static Entry entry(Model const& model, int number)
    {
        Node const made = Node::create(model);
        made->setName(ustring(1, static_cast<char16_t>(u'a' + number)));
        return made;
    }
};

struct SequenceSteps : References<ElementSequence<Node>>
{
    static void add(Collection& collection, Entry const& entry) { collection.push_back(entry); }
    static void remove(Collection& collection, Entry const& entry) { collection.remove(entry); }
};

template <Slot const& SLOT, bool UNIQUE, ElementSequence<Node>& (Node::Impl::*GETTER)() const>
struct Sequence : SequenceSteps
{
    static Collection& of(Node const& node) { return (node.getImpl()->*GETTER)(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, UNIQUE, SLOT);
    }
};

using Owned = Sequence<Node::Impl::OWNED, true, &Node::Impl::getOwned>;
using Links = Sequence<Node::Impl::LINKS, true, &Node::Impl::getLinks>;
using Children = Sequence<Node::Impl::CHILDREN, true, &Node::Impl::getChildren>;
using Parts = Sequence<Node::Impl::PARTS, false, &Node::Impl::getParts>;

template <class C> struct Inserting : References<C>
{
    static void add(C& collection, Node const& entry) { collection.insert(entry); }
    static void remove(C& collection, Node const& entry) { collection.erase(entry); }
};

struct Marks : Inserting<UnorderedElementSet<Node>>
{
    static Collection& of(Node const& node) { return node->getMarks(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, Node::Impl::MARKS);
    }
};

ustring keyOf(ModelElement::Impl* member)
{
    return static_cast<Node::Impl*>(member)->getName();
}

struct ByName : Inserting<ElementMap<ustring, Node>>
{
    static Collection& of(Node const& node) { return node->getByName(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, keyOf, Node::Impl::BY_NAME);
    }
};

struct Grouped : Inserting<ElementMultimap<ustring, Node>>
{
    static Collection& of(Node const& node) { return node->getGrouped(); }
    static std::unique_ptr<Collection> snapshot()
    {
        return std::make_unique<Collection>(nullptr, keyOf, Node::Impl::GROUPED);
    }
};

// ---------------------------------------------------------------------------- reflective elements

template <class Base, Slot const& SLOT> struct ReflectiveValues : Base
{
    using typename Base::Collection;
    using Owner = OfReflective::Owner;
    static constexpr bool IS_GIVEN_BY_SLOT = false;

    static Owner owner(Model const& model) { return OfReflective::owner(model); }
    static Collection& of(ModelElement const& element)
    {
        return dynamic_cast<Collection&>(valuesOf(element, SLOT.property()));
    }
};

using ReflectiveNumbers = ReflectiveValues<Numbers, Node::Impl::NUMBERS>;
using ReflectiveLabels = ReflectiveValues<Labels, Node::Impl::LABELS>;
using ReflectiveWords = ReflectiveValues<Words, Node::Impl::WORDS>;

template <class C, Slot const& SLOT>
struct ReflectiveReferences : OfReflective, ReferenceContents<C>
{
    using Collection = C;
    using Entry = ModelElement;

    static Entry entry(Model const& model, int number)
    {
        ModelElement const made = owner(model);
        set(made, Node::Impl::NAME.property(), ustring(1, static_cast<char16_t>(u'a' + number)));
        return made;
    }
    static Collection& of(ModelElement const& element)
    {
        return dynamic_cast<Collection&>(referencesOf(element, SLOT.property()));
    }
    static void add(C& collection, Entry const& entry)
    {
        collection.getGenericInterface()->genericAdd(entry);
    }
    static void remove(C& collection, Entry const& entry)
    {
        collection.getGenericInterface()->genericRemove(entry);
    }
    template <class... Arguments>
    static std::unique_ptr<C> snapshotOf(Arguments const&... arguments)
    {
        return std::make_unique<C>(nullptr, NodeMetamodel::get().node, arguments...,
                                   SLOT.property().getImpl(),
                                   SLOT.opposite ? SLOT.opposite->property().getImpl() : nullptr);
    }
};

template <Slot const& SLOT, bool UNIQUE>
struct ReflectiveSequence : ReflectiveReferences<ReflectiveElementSequence, SLOT>
{
    static auto snapshot() { return ReflectiveSequence::snapshotOf(UNIQUE); }
};

using ReflectiveOwned = ReflectiveSequence<Node::Impl::OWNED, true>;
using ReflectiveLinks = ReflectiveSequence<Node::Impl::LINKS, true>;
using ReflectiveChildren = ReflectiveSequence<Node::Impl::CHILDREN, true>;
using ReflectiveParts = ReflectiveSequence<Node::Impl::PARTS, false>;

struct ReflectiveMarks : ReflectiveReferences<ReflectiveUnorderedElementSet, Node::Impl::MARKS>
{
    static auto snapshot() { return snapshotOf(); }
};

ustring reflectiveKeyOf(ModelElement::Impl* member)
{
    return get<ustring>(ModelElement(member), Node::Impl::NAME.property());
}

struct ReflectiveByName : ReflectiveReferences<ReflectiveElementMap<ustring>, Node::Impl::BY_NAME>
{
    static auto snapshot() { return snapshotOf(reflectiveKeyOf); }
};

struct ReflectiveGrouped
    : ReflectiveReferences<ReflectiveElementMultimap<ustring>, Node::Impl::GROUPED>
{
    static auto snapshot() { return snapshotOf(reflectiveKeyOf); }
};

template <class Kind> class OwnedCollection : public CollectionFixture
{
protected:
    typename Kind::Entry entry(int number) { return Kind::entry(model, number); }
    auto contents() { return Kind::contents(collection); }
    void add(typename Kind::Entry const& added) { Kind::add(collection, added); }
    void remove(typename Kind::Entry const& removed) { Kind::remove(collection, removed); }

    typename Kind::Owner const owner = Kind::owner(model);
    typename Kind::Collection& collection = Kind::of(owner);
    typename Kind::Entry const first = entry(0);
    typename Kind::Entry const second = entry(1);
    typename Kind::Entry const third = entry(2);
    DeepCounter counter;
};

class KindNames
{
public:
    template <class Kind> static std::string GetName(int index)
    {
        static char const* const NAMES[] = {"Numbers", "Labels",   "Words",      "Owned",
                                            "Links",   "Children", "Parts",      "Marks",
                                            "ByName",  "Grouped",  "Attributes", "Operations"};
        constexpr int UNLIKE_NODES = 10;
        return index < UNLIKE_NODES ? NAMES[index]
                                    : std::string("Reflective") + NAMES[index - UNLIKE_NODES];
    }
};

using Kinds =
    ::testing::Types<Numbers, Labels, Words, Owned, Links, Children, Parts, Marks, ByName, Grouped,
                     ReflectiveNumbers, ReflectiveLabels, ReflectiveWords, ReflectiveOwned,
                     ReflectiveLinks, ReflectiveChildren, ReflectiveParts, ReflectiveMarks,
                     ReflectiveByName, ReflectiveGrouped>;
TYPED_TEST_SUITE(OwnedCollection, Kinds, KindNames);

TYPED_TEST(OwnedCollection, CommitsAChangeOutsideATransactionByItself)
{
    this->model->addListener(&this->counter);

    this->add(this->first);
    EXPECT_EQ(this->counter.commits, 1);
    this->add(this->second);
    EXPECT_EQ(this->counter.commits, 2);
    this->remove(this->first);
    EXPECT_EQ(this->counter.commits, 3);
    this->collection.clear();
    EXPECT_EQ(this->counter.commits, 4);
    this->collection.copyContents(*TypeParam::snapshot());
    EXPECT_EQ(this->counter.commits, 5);

    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->model->removeListener(&this->counter);
}

TYPED_TEST(OwnedCollection, CommitsNothingInsideATransaction)
{
    this->model->addListener(&this->counter);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/false);

    this->add(this->first);
    this->add(this->second);
    this->remove(this->first);
    EXPECT_EQ(this->counter.commits, 0);

    EXPECT_EQ(transaction.commit(), TransactionResult::Committed);
    EXPECT_EQ(this->counter.commits, 1);
    this->model->removeListener(&this->counter);
}

TYPED_TEST(OwnedCollection, HoldsWhatWasAddedUntilItIsRemoved)
{
    this->add(this->first);
    this->add(this->second);
    EXPECT_EQ(this->collection.size(), 2u);

    this->remove(this->first);
    EXPECT_EQ(this->collection.size(), 1u);
    EXPECT_FALSE(this->collection.empty());

    this->collection.clear();
    EXPECT_TRUE(this->collection.empty());
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST(OwnedCollection, ChangesSilentlyWithoutAnOwner)
{
    this->add(this->first);
    auto const before = this->contents();
    auto const snapshot = TypeParam::snapshot();
    this->model->addListener(&this->counter);
    Model::Freezer const frozen = this->model->freeze();

    TypeParam::add(*snapshot, this->first);
    TypeParam::add(*snapshot, this->second);
    EXPECT_EQ(snapshot->size(), 2u);
    TypeParam::remove(*snapshot, this->first);
    EXPECT_EQ(snapshot->size(), 1u);
    snapshot->copyContents(this->collection);
    EXPECT_EQ(TypeParam::contents(*snapshot), before);
    snapshot->clear();
    EXPECT_TRUE(snapshot->empty());

    EXPECT_EQ(this->contents(), before);
    EXPECT_EQ(this->counter.commits, 0);
    EXPECT_EQ(snapshot->getOwner(), nullptr);
    this->model->removeListener(&this->counter);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST(OwnedCollection, CopiesContentsExactly)
{
    this->add(this->first);
    this->add(this->second);
    auto const before = this->contents();
    auto const snapshot = TypeParam::snapshot();
    TypeParam::add(*snapshot, this->third);

    snapshot->copyContents(this->collection);
    EXPECT_EQ(TypeParam::contents(*snapshot), before);

    this->remove(this->first);
    EXPECT_EQ(TypeParam::contents(*snapshot), before) << "the copy is independent";
}

TYPED_TEST(OwnedCollection, IsAsItWasAfterARollback)
{
    this->add(this->first);
    this->add(this->second);
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->remove(this->first);
    this->add(this->third);
    this->collection.clear();
    this->add(this->first);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(this->contents(), before);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST(OwnedCollection, IsEmptyAfterARollbackIfItWasMadeInTheTransaction)
{
    auto const fresh = TypeParam::owner(this->model);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    TypeParam::add(TypeParam::of(fresh), this->first);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(TypeParam::of(fresh).empty());
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST(OwnedCollection, TakesARefusedChangeBack)
{
    this->add(this->first);
    auto const before = this->contents();
    Refuser refuser;
    this->model->addListener(&refuser);

    this->add(this->second);
    EXPECT_EQ(this->contents(), before);
    this->remove(this->first);
    EXPECT_EQ(this->contents(), before);
    this->collection.clear();
    EXPECT_EQ(this->contents(), before);

    this->model->removeListener(&refuser);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST(OwnedCollection, RefusesChangesWhileTheModelIsFrozen)
{
    this->add(this->first);
    auto const before = this->contents();
    auto const snapshot = TypeParam::snapshot();
    {
        Model::Freezer const frozen = this->model->freeze();

        EXPECT_RAISES(messages::ModelFrozen, this->add(this->second));
        EXPECT_RAISES(messages::ModelFrozen, this->remove(this->first));
        EXPECT_RAISES(messages::ModelFrozen, this->collection.clear());
        EXPECT_RAISES(messages::ModelFrozen, this->collection.copyContents(*snapshot));
        EXPECT_EQ(this->contents(), before);
    }

    EXPECT_FALSE(this->model->getCurrentTransaction());
    this->add(this->second);
    EXPECT_EQ(this->collection.size(), 2u) << "the model takes changes again";
}

TYPED_TEST(OwnedCollection, IgnoresChangesOnceItsElementIsDestroyed)
{
    this->add(this->first);
    this->owner->destroy();
    std::size_t const size = this->collection.size();
    this->model->addListener(&this->counter);

    this->add(this->second);
    this->remove(this->first);
    this->collection.clear();

    EXPECT_EQ(this->collection.size(), size);
    EXPECT_EQ(this->counter.commits, 0);
    this->model->removeListener(&this->counter);
}

TYPED_TEST(OwnedCollection, ComesBackWithItsElementWhenADestructionIsRolledBack)
{
    this->add(this->first);
    this->add(this->second);
    auto const before = this->contents();
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);

    this->owner->destroy();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_TRUE(this->owner);
    EXPECT_EQ(this->contents(), before);
    EXPECT_TRUE(this->model->checkInvariants().empty());
}

TYPED_TEST(OwnedCollection, IsRecordedByAShallowTransactionAndStaysChangedAfterItsRollback)
{
    ShallowCounter shallow;
    this->model->addShallowListener(&shallow);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/false);

    this->add(this->first);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::NotRevertible);

    EXPECT_EQ(this->collection.size(), 1u);
    this->model->removeListener(&shallow);
}

TYPED_TEST(OwnedCollection, IsNotRecordedWhileADataSourceLoads)
{
    this->model->addListener(&this->counter);
    Transaction const transaction = this->model->beginTransaction(/*revertible=*/true);
    {
        Model::DataSourceLoadingInProgressIndicator const loading(this->model);
        this->add(this->first);
    }

    static_cast<void>(transaction.rollBack());

    EXPECT_EQ(this->collection.size(), 1u) << "what is loaded is no change";
    this->model->removeListener(&this->counter);
}

TYPED_TEST(OwnedCollection, TellsAboutItsPlace)
{
    EXPECT_EQ(this->collection.getOwner(), this->owner.getImpl());
    EXPECT_TRUE(this->collection.getCollectionFeature());
    EXPECT_EQ(this->collection.getCollectionFeature().slot() != nullptr,
              TypeParam::IS_GIVEN_BY_SLOT);
}
}  // namespace
}  // namespace testkit
