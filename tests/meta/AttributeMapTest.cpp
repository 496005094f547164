#include "tarnkiln/meta/AttributeMapImpl.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/AttributeMapAttributeImpl.h"
#include "tarnkiln/meta/BooleanAttributeImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DateTimeAttributeImpl.h"
#include "tarnkiln/meta/IntegerAttributeImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/RealAttributeImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/StringAttributeImpl.h"
#include "tarnkiln/meta/UUIDAttributeImpl.h"
#include "tests/support/ExpectRaises.h"

#include <gmock/gmock.h>

namespace tarn::kiln::meta {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class AttributeMaps : public ::testing::Test
{
protected:
    template <class Handle> Handle make(ustring const& key) const
    {
        Handle const made = Handle::create(m_model);
        made->setKey(key);
        return made;
    }
    /// A new attribute in `map`.
    template <class Handle> Handle add(ustring const& key, AttributeMap const& map) const
    {
        Handle const made = make<Handle>(key);
        map->insert(made);
        return made;
    }
    template <class Handle> Handle add(ustring const& key) const { return add<Handle>(key, m_map); }
    /// A map in `outer`, under `key`.
    AttributeMap branch(ustring const& key, AttributeMap const& outer) const
    {
        AttributeMap const inner = AttributeMap::create(m_model);
        add<AttributeMapAttribute>(key, outer)->setValue(inner);
        return inner;
    }
    template <class Handle> Handle proxy() const
    {
        Handle const made(new typename Handle::Impl(m_model, UUID()));
        made->_becomeProxy(ProxyId(u"uuid", u"gone"), ElementImpl::ElementValidity::BuilderProxy);
        return made;
    }
    std::vector<ustring> keys() const
    {
        std::vector<ustring> result;
        for (auto const& [key, attribute] : m_map->getAttributes())
            result.push_back(key);
        return result;
    }
    void expectConsistent() const { EXPECT_THAT(m_model->checkInvariants(), IsEmpty()); }

    Model const m_model = Model::create(ModelConstellation());
    AttributeMap const m_map = AttributeMap::create(m_model);
};

// ---------------------------------------------------------------------------- values

TEST_F(AttributeMaps, HoldValuesThatBeginEmpty)
{
    EXPECT_FALSE(BooleanAttribute::create(m_model)->getValue());
    EXPECT_TRUE(DateTimeAttribute::create(m_model)->getValue().is_not_a_date_time());
    EXPECT_EQ(IntegerAttribute::create(m_model)->getValue(), 0);
    EXPECT_EQ(RealAttribute::create(m_model)->getValue(), 0.0);
    EXPECT_EQ(StringAttribute::create(m_model)->getValue(), u"");
    EXPECT_TRUE(UUIDAttribute::create(m_model)->getValue().is_nil());
    EXPECT_FALSE(AttributeMapAttribute::create(m_model)->getValue());
}

TEST_F(AttributeMaps, KnowTheTypesOfTheirValues)
{
    EXPECT_EQ(add<BooleanAttribute>(u"a")->getType(), StandardTypes::booleanMeta);
    EXPECT_EQ(add<DateTimeAttribute>(u"b")->getType(), StandardTypes::dateTimeMeta);
    EXPECT_EQ(add<IntegerAttribute>(u"c")->getType(), StandardTypes::integerMeta);
    EXPECT_EQ(add<RealAttribute>(u"d")->getType(), StandardTypes::realMeta);
    EXPECT_EQ(add<StringAttribute>(u"e")->getType(), StandardTypes::stringMeta);
    EXPECT_EQ(add<UUIDAttribute>(u"f")->getType(), StandardTypes::uuidMeta);
    EXPECT_EQ(add<AttributeMapAttribute>(u"g")->getType(), AttributeMap::metaClass());
    EXPECT_EQ(m_map->at(u"d")->getType(), StandardTypes::realMeta);
}

TEST_F(AttributeMaps, ContainTheMapsInsideThem)
{
    AttributeMap const inner = branch(u"inner", m_map);
    ModelElement const between = m_map->at(u"inner");

    EXPECT_EQ(inner->getOwner(), between);
    EXPECT_FALSE(m_map->getOwner());

    between->destroy();
    EXPECT_FALSE(inner);
    expectConsistent();
}

// ---------------------------------------------------------------------------- insert

TEST_F(AttributeMaps, FileAttributesByKey)
{
    RealAttribute const second = add<RealAttribute>(u"b");
    StringAttribute const first = add<StringAttribute>(u"a");

    EXPECT_THAT(keys(), ElementsAre(u"a", u"b"));
    EXPECT_EQ(m_map->at(u"a"), first);
    EXPECT_EQ(m_map->at(u"b"), second);
    EXPECT_FALSE(m_map->at(u"c").getElementImpl());
    EXPECT_EQ(first->getOwner(), m_map);
    EXPECT_EQ(first->container(), m_map);
    expectConsistent();
}

TEST_F(AttributeMaps, RefuseAKeyThatIsTaken)
{
    RealAttribute const present = add<RealAttribute>(u"k");
    StringAttribute const other = make<StringAttribute>(u"k");
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(messages::UniquenessConstraint, m_map->insert(other));

    EXPECT_FALSE(transaction.isRollBackOnly());
    EXPECT_EQ(m_map->at(u"k"), present);
    EXPECT_FALSE(other->getOwner());
    EXPECT_TRUE(other);
    transaction.commit();
    expectConsistent();
}

TEST_F(AttributeMaps, IgnoreWhatIsNotThere)
{
    StringAttribute const dead = make<StringAttribute>(u"k");
    dead->destroy();

    m_map->insert(Attribute());
    m_map->insert(dead);
    m_map->insertOrReplace(Attribute());
    m_map->insertOrReplace(dead);

    EXPECT_THAT(keys(), IsEmpty());
}

TEST_F(AttributeMaps, TakeAttributesFromOneAnother)
{
    StringAttribute const attribute = add<StringAttribute>(u"k", AttributeMap::create(m_model));
    AttributeMap const before = attribute->getOwner();

    m_map->insert(attribute);

    EXPECT_EQ(attribute->getOwner(), m_map);
    EXPECT_TRUE(before->getAttributes().empty());
    expectConsistent();
}

TEST_F(AttributeMaps, DestroyWhatTheyReplace)
{
    RealAttribute const present = add<RealAttribute>(u"k");
    StringAttribute const other = make<StringAttribute>(u"k");

    m_map->insertOrReplace(other);

    EXPECT_FALSE(present);
    EXPECT_EQ(m_map->at(u"k"), other);
    EXPECT_THAT(keys(), ElementsAre(u"k"));
    expectConsistent();
}

TEST_F(AttributeMaps, ReplaceNothingUnderAFreeKey)
{
    RealAttribute const present = add<RealAttribute>(u"a");

    m_map->insertOrReplace(make<StringAttribute>(u"b"));

    EXPECT_TRUE(present);
    EXPECT_THAT(keys(), ElementsAre(u"a", u"b"));
}

TEST_F(AttributeMaps, DoNotReplaceAnAttributeByItself)
{
    RealAttribute const present = add<RealAttribute>(u"k");

    m_map->insertOrReplace(present);

    EXPECT_TRUE(present);
    EXPECT_EQ(m_map->at(u"k"), present);
}

TEST_F(AttributeMaps, KeepWhatTheyHaveIfTheNewAttributeMayNotComeIn)
{
    RealAttribute const present = add<RealAttribute>(u"k");
    Model const foreign = Model::create(ModelConstellation());
    StringAttribute const other = StringAttribute::create(foreign);
    other->setKey(u"k");

    EXPECT_RAISES(messages::CannotCreateCrossModelAssociation, m_map->insertOrReplace(other));

    EXPECT_EQ(m_map->at(u"k"), present);
    expectConsistent();
}

// ---------------------------------------------------------------------------- keys

TEST_F(AttributeMaps, FileAnAttributeUnderItsNewKey)
{
    RealAttribute const attribute = add<RealAttribute>(u"old");

    attribute->setKey(u"new");

    EXPECT_THAT(keys(), ElementsAre(u"new"));
    EXPECT_EQ(m_map->at(u"new"), attribute);
    EXPECT_EQ(attribute->getOwner(), m_map);
    expectConsistent();
}

TEST_F(AttributeMaps, RefuseANewKeyThatIsTaken)
{
    RealAttribute const attribute = add<RealAttribute>(u"a");
    add<RealAttribute>(u"b");
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);

    EXPECT_RAISES(messages::UniquenessConstraint, attribute->setKey(u"b"));

    EXPECT_FALSE(transaction.isRollBackOnly());
    EXPECT_EQ(attribute->getKey(), u"a");
    EXPECT_EQ(m_map->at(u"a"), attribute);
    transaction.commit();
}

TEST_F(AttributeMaps, FindTheirAttributesByTheOldKeysAfterARollback)
{
    RealAttribute const renamed = add<RealAttribute>(u"a");
    RealAttribute const removed = add<RealAttribute>(u"b");
    RealAttribute const erased = add<RealAttribute>(u"c");
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    renamed->setKey(u"z");
    m_map->remove(u"b");
    m_map->erase(u"c");
    add<RealAttribute>(u"d");

    transaction.rollBack();

    EXPECT_THAT(keys(), ElementsAre(u"a", u"b", u"c"));
    EXPECT_EQ(m_map->at(u"a"), renamed);
    EXPECT_EQ(m_map->at(u"b"), removed);
    EXPECT_EQ(erased->getOwner(), m_map);
    expectConsistent();
}

// ---------------------------------------------------------------------------- erase and remove

TEST_F(AttributeMaps, LetGoOfAnErasedAttribute)
{
    RealAttribute const attribute = add<RealAttribute>(u"k");

    m_map->erase(u"k");

    EXPECT_TRUE(attribute);
    EXPECT_FALSE(attribute->getOwner());
    EXPECT_TRUE(attribute->isTopLevel());
    EXPECT_THAT(keys(), IsEmpty());
    expectConsistent();
}

TEST_F(AttributeMaps, LetGoOfAnErasedValue)
{
    RealAttribute const attribute = add<RealAttribute>(u"k");

    m_map->eraseValue(attribute);

    EXPECT_TRUE(attribute);
    EXPECT_FALSE(attribute->getOwner());
    EXPECT_THAT(keys(), IsEmpty());
    expectConsistent();
}

TEST_F(AttributeMaps, EraseStandInsToo)
{
    RealAttribute const standIn = proxy<RealAttribute>();
    m_map->insert(standIn);
    ASSERT_EQ(m_map->getAttributes().getAllValuesAndProxies().size(), 1u);

    m_map->eraseValue(standIn);

    EXPECT_THAT(m_map->getAttributes().getAllValuesAndProxies(), IsEmpty());
}

TEST_F(AttributeMaps, DestroyARemovedAttribute)
{
    RealAttribute const attribute = add<RealAttribute>(u"k");

    m_map->remove(u"k");

    EXPECT_FALSE(attribute);
    EXPECT_THAT(keys(), IsEmpty());
    expectConsistent();
}

TEST_F(AttributeMaps, DestroyARemovedValue)
{
    RealAttribute const attribute = add<RealAttribute>(u"k");

    m_map->removeValue(attribute);

    EXPECT_FALSE(attribute);
    EXPECT_THAT(keys(), IsEmpty());
    expectConsistent();
}

TEST_F(AttributeMaps, LeaveWhatIsNotTheirs)
{
    RealAttribute const mine = add<RealAttribute>(u"k");
    RealAttribute const others = add<RealAttribute>(u"k", AttributeMap::create(m_model));
    RealAttribute const dead = make<RealAttribute>(u"dead");
    dead->destroy();

    m_map->eraseValue(others);
    m_map->removeValue(others);
    m_map->eraseValue(dead);
    m_map->removeValue(dead);
    m_map->eraseValue(Attribute());
    m_map->removeValue(Attribute());
    m_map->erase(u"absent");
    m_map->remove(u"absent");

    EXPECT_TRUE(others);
    EXPECT_TRUE(others->getOwner());
    EXPECT_EQ(m_map->at(u"k"), mine);
}

// ---------------------------------------------------------------------------- paths

TEST_F(AttributeMaps, FollowAPathOfKeys)
{
    AttributeMap const inner = branch(u"b", branch(u"a", m_map));
    StringAttribute const leaf = add<StringAttribute>(u"c", inner);

    EXPECT_EQ(m_map->recursiveAt({u"a", u"b", u"c"}), leaf);
    EXPECT_EQ(m_map->recursiveAt({u"a"}), m_map->at(u"a"));
    EXPECT_EQ(m_map->recursiveAt({u"a", u"b"}), inner->getOwner());
}

TEST_F(AttributeMaps, FindNothingAtTheEndOfAPathThatBreaks)
{
    AttributeMap const inner = branch(u"a", m_map);
    add<StringAttribute>(u"text", m_map);
    add<StringAttribute>(u"text", inner);
    add<AttributeMapAttribute>(u"hollow", m_map);

    EXPECT_FALSE(m_map->recursiveAt({}).getElementImpl());
    EXPECT_FALSE(m_map->recursiveAt({u"absent"}).getElementImpl());
    EXPECT_FALSE(m_map->recursiveAt({u"absent", u"text"}).getElementImpl());
    EXPECT_FALSE(m_map->recursiveAt({u"text", u"text"}).getElementImpl());
    EXPECT_FALSE(m_map->recursiveAt({u"a", u"text", u"text"}).getElementImpl());
    EXPECT_FALSE(m_map->recursiveAt({u"hollow", u"text"}).getElementImpl());
}

TEST_F(AttributeMaps, FollowAPartOfAPath)
{
    AttributeMap const inner = branch(u"a", m_map);
    StringAttribute const leaf = add<StringAttribute>(u"b", inner);
    std::vector<ustring> const path{u"x", u"a", u"b", u"y"};

    EXPECT_EQ(m_map->doRecurse(path, 1, 3), leaf);
    EXPECT_EQ(m_map->doRecurse(path, 1, 2), inner->getOwner());
    EXPECT_EQ(inner->doRecurse(path, 2, 3), leaf);
    EXPECT_FALSE(m_map->doRecurse(path, 1, 1).getElementImpl());
    EXPECT_FALSE(m_map->doRecurse(path, 3, 1).getElementImpl());
}

TEST_F(AttributeMaps, FindNothingBeyondAPath)
{
    branch(u"a", m_map);

    EXPECT_FALSE(m_map->doRecurse({u"a"}, 0, 2).getElementImpl());
    EXPECT_FALSE(m_map->doRecurse({u"a"}, 1, 2).getElementImpl());
    EXPECT_FALSE(m_map->doRecurse({u"a"}, -1, 1).getElementImpl());
}

// ---------------------------------------------------------------------------- emplace

TEST_F(AttributeMaps, EmplaceNothingForANameWithoutClass)
{
    std::size_t const before = m_model->getElementCount();

    EXPECT_FALSE(m_map->emplace(u"Nonsense", u"k").getElementImpl());
    EXPECT_FALSE(m_map->emplace(u"some.Nonsense", u"k").getElementImpl());
    EXPECT_FALSE(m_map->emplace(u"", u"k").getElementImpl());

    EXPECT_THAT(keys(), IsEmpty());
    EXPECT_EQ(m_model->getElementCount(), before);
}

// ---------------------------------------------------------------------------- derived classes

namespace {

/// Notes which steps are reached through others.
class TracedMap : public AttributeMap::Impl
{
public:
    using AttributeMap::Impl::Impl;

    void insert(Attribute const& attribute) override
    {
        trace.push_back("insert");
        AttributeMap::Impl::insert(attribute);
    }
    void remove(ustring const& key) override
    {
        trace.push_back("remove");
        AttributeMap::Impl::remove(key);
    }
    Attribute doRecurse(std::vector<ustring> const& keys, int index, int size) const override
    {
        trace.push_back("doRecurse " + std::to_string(index) + " " + std::to_string(size));
        return AttributeMap::Impl::doRecurse(keys, index, size);
    }

    mutable std::vector<std::string> trace;
};
}  // namespace

TEST_F(AttributeMaps, TakeTheStepsOfADerivedClass)
{
    auto* const traced = new TracedMap(m_model, UUID());
    AttributeMap const map(traced);
    map->notifyCreated();
    RealAttribute const attribute = make<RealAttribute>(u"k");

    map->insertOrReplace(attribute);
    map->recursiveAt({u"k", u"l"});
    map->removeValue(attribute);

    EXPECT_THAT(traced->trace, ElementsAre("insert", "doRecurse 0 2", "remove"));
    EXPECT_FALSE(attribute);
}

TEST_F(AttributeMaps, ReachMapsInsideThemThroughTheirOwnSteps)
{
    auto* const traced = new TracedMap(m_model, UUID());
    AttributeMap const inner(traced);
    inner->notifyCreated();
    add<AttributeMapAttribute>(u"a")->setValue(inner);

    m_map->recursiveAt({u"a", u"b"});

    EXPECT_THAT(traced->trace, ElementsAre("doRecurse 1 2"));
}

TEST_F(AttributeMaps, CanNotBeReadThroughAStandIn)
{
    AttributeMap const standIn = proxy<AttributeMap>();

    EXPECT_RAISES(messages::CannotModifyProxy, standIn->at(u"k"));
    EXPECT_RAISES(messages::CannotModifyProxy, standIn->insert(make<RealAttribute>(u"k")));
}
}  // namespace tarn::kiln::meta
