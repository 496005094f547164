#include "tarnkiln/kernel/ChangesHolder.h"

#include "tarnkiln/meta/PropertyImpl.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/SpecialNodeImpl.h"

namespace {

using namespace testkit;
using Changes = ModelElement::Impl::Changes;
using Storage = ModelElement::Impl::Storage;

meta::Property const& propertyAt(Slot const& slot)
{
    return NodeMetamodel::get().properties[slot.index];
}

class ChangeRecord : public testing::Test
{
protected:
    Model const model = Model::createTransientModel();
    Node const node = Node::create(model);
};

TEST_F(ChangeRecord, StartWithNothingMarked)
{
    UUID const id = ElementImpl::generateNewUuid();
    Changes const changes(id, model, Node::metaClass(), 5);

    EXPECT_EQ(id, changes.getUuid());
    EXPECT_EQ(model, changes.getModel());
    EXPECT_EQ(Node::metaClass(), changes.getMetaClass());
    EXPECT_FALSE(changes.isCreated());
    EXPECT_FALSE(changes.isDestroyed());
    EXPECT_FALSE(changes.isContainerChanged());
    for (unsigned long index = 0; index < 10; ++index)
        EXPECT_FALSE(changes.isSlotChanged(index));
}

TEST_F(ChangeRecord, MarkASlotAndTellWhetherItWasMarkedBefore)
{
    Changes changes(UUID{}, model, Node::metaClass(), 5);

    EXPECT_FALSE(changes.setModified(4));
    EXPECT_TRUE(changes.setModified(4));

    EXPECT_TRUE(changes.isSlotChanged(4));
    EXPECT_FALSE(changes.isSlotChanged(3));
    EXPECT_FALSE(changes.isContainerChanged()) << "the last slot is not the container";
    EXPECT_FALSE(changes.isDestroyed());
}

TEST_F(ChangeRecord, HaveNoSlotZeroAndNoneBeyondTheLast)
{
    Changes changes(UUID{}, model, Node::metaClass(), 5);

    EXPECT_TRUE(changes.setModified(0));
    EXPECT_TRUE(changes.setModified(5));
    EXPECT_TRUE(changes.setModified(6));
    EXPECT_TRUE(changes.setModified(ModelElement::Impl::NO_INDEX));

    EXPECT_FALSE(changes.isSlotChanged(0));
    EXPECT_FALSE(changes.isSlotChanged(5));
    EXPECT_FALSE(changes.isCreated());
    EXPECT_FALSE(changes.isContainerChanged());
    EXPECT_FALSE(changes.isDestroyed());
}

TEST_F(ChangeRecord, KeepCreationDestructionAndSlotsApart)
{
    Changes changes(UUID{}, model, Node::metaClass(), 200);

    changes.setCreated();
    EXPECT_TRUE(changes.isCreated());
    EXPECT_FALSE(changes.isDestroyed());
    changes.setDestroyed();
    EXPECT_TRUE(changes.isDestroyed());
    for (unsigned long const index : {1, 63, 64, 65, 127, 128, 199})
        EXPECT_FALSE(changes.setModified(index));
    for (unsigned long index = 1; index < 200; ++index)
        EXPECT_EQ(index == 1 || (index >= 63 && index <= 65) || index == 127 || index == 128 ||
                      index == 199,
                  changes.isSlotChanged(index));
}

TEST_F(ChangeRecord, KnowThePropertiesOfTheirClassOnly)
{
    Changes changes(UUID{}, model, Node::metaClass(), SpecialNode::Impl::SLOTS);
    for (unsigned long index = 1; index < SpecialNode::Impl::SLOTS; ++index)
        changes.setModified(index);

    EXPECT_TRUE(changes.isChanged(propertyAt(Node::Impl::COUNT)));
    EXPECT_FALSE(changes.isChanged(propertyAt(SpecialNode::Impl::LEVEL)));
    EXPECT_FALSE(changes.isChanged(meta::Property()));
}

TEST_F(ChangeRecord, WithoutOldValuesCallAnythingReallyChanged)
{
    Changes changes(UUID{}, model, Node::metaClass(), 5);
    EXPECT_TRUE(changes.revertUnchanged(node.getImpl()));

    changes.setModified(3);
    EXPECT_TRUE(changes.revertUnchanged(node.getImpl()));
}

// ---------------------------------------------------------------------------- old values

TEST_F(ChangeRecord, KeepTheFirstOldContainer)
{
    Node const first = Node::create(model);
    Node const second = Node::create(model);
    Storage storage(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);

    storage.setOldContainer(first, propertyAt(Node::Impl::CHILDREN));
    storage.setOldContainer(second, propertyAt(Node::Impl::PARTS));

    EXPECT_TRUE(storage.isContainerChanged());
    EXPECT_EQ(first, storage.getOldContainer());
    EXPECT_EQ(propertyAt(Node::Impl::CHILDREN), storage.getOldContainmentProperty());
}

TEST_F(ChangeRecord, KeepThatThereWasNoContainer)
{
    Node const later = Node::create(model);
    Storage storage(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);

    storage.setOldContainer(ModelElement(), meta::Property());
    storage.setOldContainer(later, propertyAt(Node::Impl::PARTS));

    EXPECT_TRUE(storage.isContainerChanged());
    EXPECT_EQ(ModelElement(), storage.getOldContainer());
}

TEST_F(ChangeRecord, ClearTheContainerThatIsWhatItWas)
{
    Node const container = Node::create(model);
    container->getChildren().push_back(node);
    Storage same(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);
    same.setOldContainer(container, propertyAt(Node::Impl::CHILDREN));
    Storage otherProperty(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);
    otherProperty.setOldContainer(container, propertyAt(Node::Impl::PARTS));
    Storage otherContainer(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);
    otherContainer.setOldContainer(node, propertyAt(Node::Impl::CHILDREN));
    Storage alsoModified(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);
    alsoModified.setOldContainer(container, propertyAt(Node::Impl::CHILDREN));
    alsoModified.setModified(Node::Impl::COUNT.index);

    EXPECT_FALSE(same.revertUnchanged(node.getImpl()));
    EXPECT_FALSE(same.isContainerChanged());
    EXPECT_FALSE(same.revertUnchanged(node.getImpl())) << "the answer stays";
    EXPECT_TRUE(otherProperty.revertUnchanged(node.getImpl()));
    EXPECT_TRUE(otherContainer.revertUnchanged(node.getImpl()));
    EXPECT_TRUE(alsoModified.revertUnchanged(node.getImpl()));
    EXPECT_FALSE(alsoModified.isContainerChanged());
}

TEST_F(ChangeRecord, TakeTheContainerAgainAfterItWasWhatItWas)
{
    Node const container = Node::create(model);
    container->getChildren().push_back(node);
    Storage storage(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);
    storage.setOldContainer(container, propertyAt(Node::Impl::CHILDREN));
    ASSERT_FALSE(storage.revertUnchanged(node.getImpl()));

    storage.setOldContainer(ModelElement(), meta::Property());

    EXPECT_TRUE(storage.isContainerChanged());
    EXPECT_EQ(ModelElement(), storage.getOldContainer());
    EXPECT_FALSE(storage.getOldContainmentProperty());
}

TEST_F(ChangeRecord, HaveNoRoomForPropertiesThatDidNotChange)
{
    EXPECT_EQ(sizeof(Storage), sizeof(Node::Impl::Storage));
    EXPECT_EQ(sizeof(Storage), sizeof(SpecialNode::Impl::Storage));
}

TEST_F(ChangeRecord, KeepTheirElementInMemoryOnlyWhenTold)
{
    auto record = std::make_unique<Changes>(UUID{}, model, Node::metaClass(), 5);
    std::uint32_t const handles = node.getImpl()->getRefCount();
    record->setElement(node.getImpl());
    EXPECT_EQ(nullptr, record->getKeptElement());
    EXPECT_EQ(handles, node.getImpl()->getRefCount());

    record->keepElement(node.getImpl());
    record->keepElement(node.getImpl());
    EXPECT_EQ(node.getImpl(), record->getKeptElement());
    EXPECT_EQ(handles + 1, node.getImpl()->getRefCount());

    record->releaseElement();
    record->releaseElement();
    EXPECT_EQ(nullptr, record->getKeptElement());
    EXPECT_EQ(handles, node.getImpl()->getRefCount());

    record->keepElement(node.getImpl());
    record.reset();
    EXPECT_EQ(handles, node.getImpl()->getRefCount());
}

TEST_F(ChangeRecord, HaveNoOldValueOfAPropertyThatIsNoneOfTheirs)
{
    Storage const base(UUID{}, model, Node::metaClass(), Node::Impl::SLOTS);
    EXPECT_RAISES_WITH(
        messages::NoSuchProperty,
        base.getOldValue(propertyAt(Node::Impl::COUNT), ModelElement::Impl::PUBLIC_ACCESS),
        u"count", u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       base.getOldValue(meta::Property(), ModelElement::Impl::PUBLIC_ACCESS), u"",
                       u"testkit.Node");

    std::unique_ptr<Storage> const ofNode(node->createStorage());
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       ofNode->getOldValue(propertyAt(SpecialNode::Impl::LEVEL),
                                           ModelElement::Impl::PUBLIC_ACCESS),
                       u"level", u"testkit.Node");
}

TEST_F(ChangeRecord, OfAClassKeepTheValueOfASlotThatIsCopied)
{
    node->setCount(3);
    std::unique_ptr<Storage> const storage(node->createStorage());
    node->copyValue(storage.get(), Node::Impl::COUNT.index);
    storage->setModified(Node::Impl::COUNT.index);
    node->setCount(4);

    EXPECT_EQ(3,
              storage->getOldValue(propertyAt(Node::Impl::COUNT), ModelElement::Impl::PUBLIC_ACCESS)
                  .getValue<int>());
    node->copyStateFromStorage(storage.get());
    EXPECT_EQ(3, node->getCount());
}

TEST_F(ChangeRecord, CannotKeepASlotThatTheClassDoesNotHave)
{
    std::unique_ptr<Storage> const storage(node->createStorage());

    EXPECT_RAISES_WITH(messages::NoSuchProperty, node->copyValue(storage.get(), 99), u"",
                       u"testkit.Node");
}

// ---------------------------------------------------------------------------- holders

/// Tells when it goes.
class Watched : public Changes
{
public:
    Watched(Model const& model, int& alive)
        : Changes(UUID{}, model, meta::Class(), 1),
          m_alive(alive)
    {
        ++m_alive;
    }
    ~Watched() override { --m_alive; }

private:
    int& m_alive;
};

TEST_F(ChangeRecord, AreDeletedWithTheirLastHolder)
{
    int alive = 0;
    auto first = std::make_unique<ChangesHolder>(new Watched(model, alive));
    auto second = std::make_unique<ChangesHolder>(*first);
    ChangesHolder third(std::move(*second));
    EXPECT_FALSE(*second);
    EXPECT_EQ(first->get(), third.get());

    first.reset();
    second.reset();
    EXPECT_EQ(1, alive);

    third = ChangesHolder();
    EXPECT_EQ(0, alive);
}

TEST_F(ChangeRecord, SwapWithTheirHolders)
{
    int alive = 0;
    auto* const one = new Watched(model, alive);
    auto* const two = new Watched(model, alive);
    ChangesHolder a(one);
    ChangesHolder b(two);

    a.swap(b);
    EXPECT_EQ(two, a.get());
    EXPECT_EQ(one, b.get());

    a = b;
    EXPECT_EQ(1, alive);
    EXPECT_EQ(one, a.get());
}

TEST_F(ChangeRecord, MayBeMissingInAHolder)
{
    ChangesHolder const none(nullptr);
    ChangesHolder const copy = none;

    EXPECT_FALSE(none);
    EXPECT_EQ(nullptr, copy.get());
}
}  // namespace
