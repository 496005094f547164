// References of generated classes.
#include "shapes/KeyedImpl.h"
#include "shapes/KeysImpl.h"
#include "shapes/NodeImpl.h"
#include "shapes/NoteImpl.h"
#include "tests/generated/ShapesFixture.h"

namespace testkit::shapes {
namespace {

using ReferenceProperty = ShapesTest;

class KeyedReference : public ShapesTest
{
protected:
    Node node(ustring const& name) const
    {
        Node const made = Node::create(m_model);
        made->setName(name);
        return made;
    }
};

TEST_F(ReferenceProperty, KeepsBothEndsInStep)
{
    Node const left = Node::create(m_model);
    Node const right = Node::create(m_model);
    Node const other = Node::create(m_model);

    left->setRight(right);
    EXPECT_EQ(right->getLeft(), left);
    left->setRight(other);
    EXPECT_FALSE(right->hasLeft());
    EXPECT_EQ(other->getLeft(), left);

    left->getOwned().push_back(right);
    EXPECT_EQ(right->getOwner(), left);
    right->setOwner(Node());
    EXPECT_EQ(left->getOwned().size(), 0u);

    left->getLinks().push_back(right);
    EXPECT_EQ(right->getBacklinks()[0], left);
}

TEST_F(ReferenceProperty, ContainsWhatItIsCompositeOver)
{
    Node const parent = Node::create(m_model);
    Node const child = Node::create(m_model);
    Node const part = Node::create(m_model);
    Node const core = Node::create(m_model);
    Node const body = Node::create(m_model);

    child->setParent(parent);
    parent->getParts().push_back(part);
    parent->setCore(core);
    body->setHost(parent);

    EXPECT_EQ(parent->getChildren()[0], child);
    EXPECT_EQ(parent->getBody(), body);
    for (Node const& contained : {child, part, core, body})
        EXPECT_EQ(contained->container(), parent);

    parent->destroy();
    for (Node const& contained : {child, part, core, body})
        EXPECT_FALSE(contained);
}

TEST_F(ReferenceProperty, LeadsToElementsOfOtherMetamodels)
{
    Node const node = Node::create(m_model);
    Note const note = Note::create(m_model);

    node->setAbout(note);
    node->setDescribed(Note::metaClass());
    note->setName(u"a note");
    note->setLanguage(meta::Language::CPlusPlus);

    EXPECT_EQ(node->getAbout(), note);
    EXPECT_EQ(node->getDescribed(), Note::metaClass());
    EXPECT_EQ(meta::NamedElement::cast(note)->getName(), u"a note");
    EXPECT_TRUE(Note::metaClass()->isA(meta::NamedElement::metaClass()));
    EXPECT_EQ(read(note, u"language").getValue<meta::Language>(), meta::Language::CPlusPlus);
}

TEST_F(KeyedReference, FindsMembersByKeysOfEveryType)
{
    Keys const keys = Keys::create(m_model);
    Keyed const member = Keyed::create(m_model);
    member->setText(u"text");
    member->setBytes("bytes");
    member->setInteger(-32);
    member->setInteger8(-8);
    member->setInteger16(-16);
    member->setInteger64(-64);
    member->setNatural(32);
    member->setUnsigned8(8);
    member->setUnsigned16(16);
    member->setUnsigned64(64);
    member->setReal(0.5);
    member->setId(UUID{{7}});
    member->setColour(Colour::Red);

    keys->getByText().insert(member);
    keys->getByBytes().insert(member);
    keys->getByInteger().insert(member);
    keys->getByInteger8().insert(member);
    keys->getByInteger16().insert(member);
    keys->getByInteger64().insert(member);
    keys->getByNatural().insert(member);
    keys->getByUnsigned8().insert(member);
    keys->getByUnsigned16().insert(member);
    keys->getByUnsigned64().insert(member);
    keys->getByReal().insert(member);
    keys->getById().insert(member);
    keys->getByColour().insert(member);

    EXPECT_EQ(keys->getByText().find(u"text"), member);
    EXPECT_EQ(keys->getByBytes().find("bytes"), member);
    EXPECT_EQ(keys->getByInteger().find(-32), member);
    EXPECT_EQ(keys->getByInteger8().find(-8), member);
    EXPECT_EQ(keys->getByInteger16().find(-16), member);
    EXPECT_EQ(keys->getByInteger64().find(-64), member);
    EXPECT_EQ(keys->getByNatural().find(32), member);
    EXPECT_EQ(keys->getByUnsigned8().find(8), member);
    EXPECT_EQ(keys->getByUnsigned16().find(16), member);
    EXPECT_EQ(keys->getByUnsigned64().find(64), member);
    EXPECT_EQ(keys->getByReal().find(0.5), member);
    EXPECT_EQ(keys->getById().find(UUID{{7}}), member);
    EXPECT_EQ(keys->getByColour().find(static_cast<unsigned long>(Colour::Red)), member);
    EXPECT_EQ(member->getKeys(), keys);
}

TEST_F(KeyedReference, MovesWithAnInheritedKeyThatIsALiteral)
{
    Keys const keys = Keys::create(m_model);
    Keyed const member = Keyed::create(m_model);
    Keyed const other = Keyed::create(m_model);
    other->setColour(Colour::Green);
    member->setKeys(keys);
    other->setKeys(keys);

    member->setColour(Colour::Red);

    EXPECT_EQ(keys->getByColour().find(static_cast<unsigned long>(Colour::Red)), member);
    EXPECT_FALSE(keys->getByColour().find(static_cast<unsigned long>(Colour::None)));
    EXPECT_RAISES(messages::UniquenessConstraint, member->setColour(Colour::Green));
    EXPECT_RAISES(messages::UniquenessConstraint,
                  static_cast<Scalars::Impl*>(member.getImpl())->setColour(Colour::Green));
    EXPECT_EQ(member->getColour(), Colour::Red);
}

TEST_F(KeyedReference, MovesInTheCollectionsOfAllOwners)
{
    Node const scope = node(u"scope");
    Node const group = node(u"group");
    Node const list = node(u"list");
    Node const member = node(u"a");
    member->setScope(scope);
    member->setGroup(group);
    member->setList(list);

    member->setName(u"b");

    EXPECT_EQ(scope->getNamed().find(u"b"), member);
    EXPECT_FALSE(scope->getNamed().find(u"a"));
    EXPECT_EQ(list->getListed().find(u"b"), member);
    EXPECT_FALSE(list->getListed().find(u"a"));
    EXPECT_TRUE(group->getGrouped().contains(member));
    EXPECT_EQ(group->getGrouped().size(), 1u);
    EXPECT_EQ(m_model->checkInvariants(), std::vector<string>());
}

TEST_F(KeyedReference, RefusesAKeyThatIsTakenInAnyOfThem)
{
    Node const scope = node(u"scope");
    Node const list = node(u"list");
    Node const member = node(u"a");
    Node const named = node(u"b");
    Node const listed = node(u"c");
    member->setScope(scope);
    member->setList(list);
    named->setScope(scope);
    listed->setList(list);

    EXPECT_RAISES(messages::UniquenessConstraint, member->setName(u"b"));
    EXPECT_RAISES(messages::UniquenessConstraint, member->setName(u"c"));

    EXPECT_EQ(member->getName(), u"a");
    EXPECT_EQ(scope->getNamed().find(u"a"), member);
    EXPECT_EQ(list->getListed().find(u"a"), member);
}

TEST_F(KeyedReference, AdmitsOneKeySeveralTimesWhereThatIsSaid)
{
    Node const group = node(u"group");
    Node const first = node(u"a");
    Node const second = node(u"b");
    first->setGroup(group);
    second->setGroup(group);

    second->setName(u"a");

    EXPECT_EQ(group->getGrouped().size(), 2u);
}

TEST_F(ReferenceProperty, IsNotMadeToTellThatItHasNoMembers)
{
    Node const parent = Node::create(m_model);
    Node const child = Node::create(m_model);
    meta::Property const children = property(Node::metaClass(), u"children");

    EXPECT_FALSE(parent->hasPropertyValue(children, ModelElement::Impl::PUBLIC_ACCESS));
    EXPECT_FALSE(parent->hasChildren()) << "no collection yet";

    child->setParent(parent);
    EXPECT_TRUE(parent->hasPropertyValue(children, ModelElement::Impl::PUBLIC_ACCESS));
}

TEST_F(KeyedReference, RefusesAnOwnerThatHasTheKeyAlready)
{
    Node const scope = node(u"scope");
    Node const list = node(u"list");
    Node const member = node(u"a");
    Node const other = node(u"a");
    member->setScope(scope);
    member->setList(list);

    EXPECT_RAISES(messages::UniquenessConstraint, other->setScope(scope));
    EXPECT_RAISES(messages::UniquenessConstraint, other->setList(list));

    EXPECT_FALSE(other->hasScope());
    EXPECT_FALSE(other->hasList());
    EXPECT_EQ(list->getListed().find(u"a"), member);
}

TEST_F(ReferenceProperty, IsBroughtBackByARollback)
{
    Node const parent = Node::create(m_model);
    Node const child = Node::create(m_model);
    child->setName(u"a");
    child->setParent(parent);
    child->setGroup(parent);
    child->setBuddy(parent);

    takeBack([&] {
        child->setName(u"b");
        child->setBuddy(child);
        parent->destroy();
    });

    EXPECT_EQ(parent->getChildren()[0], child);
    EXPECT_EQ(child->getBuddy(), parent);
    EXPECT_EQ(child->getName(), u"a");
    EXPECT_TRUE(parent->getGrouped().contains(child));
}
}  // namespace
}  // namespace testkit::shapes
