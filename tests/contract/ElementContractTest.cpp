// What holds for elements with and without code of their own, as reflection sees them.
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/RuntimeMetamodel.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

namespace testkit {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

/// A class written as generated ones are.
struct HandWritten
{
    static ModelElement make(Model const& model) { return Node::create(model); }
};

/// The same class, as if it had no code.
struct Reflective
{
    static ModelElement make(Model const& model)
    {
        return ModelElement::createReflective(model, NodeMetamodel::get().node);
    }
};

template <class Kind> class Element : public ::testing::Test
{
protected:
    ~Element() override { EXPECT_THAT(model->checkInvariants(), IsEmpty()); }

    ModelElement make() { return Kind::make(model); }
    Transaction begin() { return model->beginTransaction(/*revertible=*/true); }
    static GenericSequenceInterface& sequenceOf(ModelElement const& element,
                                                meta::Property const& property)
    {
        return dynamic_cast<GenericSequenceInterface&>(
            *referencesOf(element, property).getGenericInterface());
    }
    static std::vector<ModelElement> entriesOf(ModelElement const& element,
                                               meta::Property const& property)
    {
        return referencesOf(element, property).getAllValuesAndProxies();
    }

    Model const model = Model::create(ModelConstellation());
    meta::Property const name = Node::Impl::NAME.property();
    meta::Property const count = Node::Impl::COUNT.property();
    meta::Property const rank = Node::Impl::RANK.property();
    meta::Property const buddy = Node::Impl::BUDDY.property();
    meta::Property const left = Node::Impl::LEFT.property();
    meta::Property const right = Node::Impl::RIGHT.property();
    meta::Property const owned = Node::Impl::OWNED.property();
    meta::Property const owner = Node::Impl::OWNER.property();
    meta::Property const links = Node::Impl::LINKS.property();
    meta::Property const backlinks = Node::Impl::BACKLINKS.property();
    meta::Property const children = Node::Impl::CHILDREN.property();
    meta::Property const parent = Node::Impl::PARENT.property();
    meta::Property const core = Node::Impl::CORE.property();
    meta::Property const byName = Node::Impl::BY_NAME.property();
    meta::Property const scope = Node::Impl::SCOPE.property();
    meta::Property const numbers = Node::Impl::NUMBERS.property();
};

using Elements = ::testing::Types<HandWritten, Reflective>;
TYPED_TEST_SUITE(Element, Elements);

TYPED_TEST(Element, StartsEmpty)
{
    ModelElement const x = this->make();

    EXPECT_EQ(x->getMetaClass(), NodeMetamodel::get().node);
    EXPECT_EQ(get<int>(x, this->count), 0);
    EXPECT_TRUE(has(x, this->count));
    EXPECT_FALSE(getOptional<int>(x, this->rank));
    EXPECT_FALSE(has(x, this->rank));
    for (meta::Property const& reference : {this->buddy, this->left, this->owner, this->parent})
    {
        EXPECT_FALSE(targetOf(x, reference));
        EXPECT_FALSE(has(x, reference));
    }
    for (meta::Property const& collection : {this->owned, this->links, this->children})
        EXPECT_FALSE(has(x, collection));
    EXPECT_FALSE(has(x, this->numbers));
}

TYPED_TEST(Element, IsReadAsItWasSet)
{
    ModelElement const x = this->make(), y = this->make();

    set(x, this->name, u"Emma");
    set(x, this->rank, boost::optional<int>(3));
    set(x, this->buddy, y);

    EXPECT_EQ(valueOf(x, this->name), Value(StandardTypes::stringMeta, ustring(u"Emma")));
    EXPECT_EQ(getOptional<int>(x, this->rank), 3);
    EXPECT_TRUE(has(x, this->rank));
    EXPECT_EQ(valueOf(x, this->buddy), Value::createElementValue(this->buddy, y));
}

TYPED_TEST(Element, RefusesAPropertyOfAnotherClass)
{
    meta::Property const level = NodeMetamodel::get().properties[NodeMetamodel::LAST_INDEX];
    ModelElement const x = this->make();

    EXPECT_RAISES_WITH(messages::NoSuchProperty, valueOf(x, level), level->getName(),
                       u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty, has(x, level), level->getName(), u"testkit.Node");
    EXPECT_RAISES_WITH(messages::NoSuchProperty,
                       setValue(x, level, Value::createElementValue(level, ModelElement())),
                       level->getName(), u"testkit.Node");
    EXPECT_RAISES(messages::NoSuchProperty, valueOf(x, meta::Property()));
}

TYPED_TEST(Element, KeepsBothEndsOfAnAssociationInStep)
{
    ModelElement const a = this->make(), b = this->make(), c = this->make(), d = this->make();
    set(a, this->left, b);
    set(d, this->left, c);

    set(a, this->left, c);
    EXPECT_EQ(targetOf(c, this->right), a);
    EXPECT_FALSE(targetOf(b, this->right));
    EXPECT_FALSE(targetOf(d, this->left));

    set(a, this->owner, b);
    EXPECT_THAT(this->entriesOf(b, this->owned), ElementsAre(a));
    this->sequenceOf(c, this->owned).genericAdd(a);
    EXPECT_THAT(this->entriesOf(b, this->owned), IsEmpty());
    EXPECT_EQ(targetOf(a, this->owner), c);

    this->sequenceOf(a, this->links).genericAdd(d);
    EXPECT_THAT(this->entriesOf(d, this->backlinks), ElementsAre(a));
}

TYPED_TEST(Element, MovesBetweenContainers)
{
    ModelElement const p = this->make(), q = this->make(), x = this->make();

    set(x, this->parent, p);
    EXPECT_EQ(x->container(), p);
    EXPECT_THAT(this->entriesOf(p, this->children), ElementsAre(x));
    this->sequenceOf(q, this->children).genericAdd(x);
    EXPECT_EQ(targetOf(x, this->parent), q);
    EXPECT_THAT(this->entriesOf(p, this->children), IsEmpty());
    set(p, this->core, x);
    EXPECT_EQ(x->containmentFeature(), this->core);
    EXPECT_FALSE(has(x, this->parent));
    clear(p, this->core);
    EXPECT_TRUE(x->isTopLevel());
}

TYPED_TEST(Element, IsNotContainedByItself)
{
    ModelElement const p = this->make(), x = this->make();
    set(x, this->parent, p);

    EXPECT_RAISES(messages::CircularContainment, set(p, this->parent, x));
    EXPECT_RAISES(messages::CircularContainment, set(x, this->core, p));

    EXPECT_TRUE(p->isTopLevel());
}

TYPED_TEST(Element, IsFiledUnderItsNewKey)
{
    ModelElement const p = this->make(), x = this->make(), y = this->make();
    auto const find = [&](ustring const& key) {
        auto& map = dynamic_cast<GenericMapInterface&>(
            *referencesOf(p, this->byName).getGenericInterface());
        return map.genericFind(Value(StandardTypes::stringMeta, key));
    };
    set(x, this->name, u"x");
    set(y, this->name, u"y");
    set(x, this->scope, p);
    set(y, this->scope, p);

    set(x, this->name, u"z");
    EXPECT_EQ(find(u"z"), x);
    EXPECT_FALSE(find(u"x"));
    EXPECT_RAISES(messages::UniquenessConstraint, set(y, this->name, u"z"));
    EXPECT_EQ(find(u"y"), y);
}

TYPED_TEST(Element, TellsReportsWhatItWas)
{
    ModelElement const x = this->make(), y = this->make(), z = this->make();
    set(x, this->name, u"old");
    set(x, this->owner, y);
    ScriptedListener listener;
    listen(this->model, listener);

    Transaction const transaction = this->begin();
    set(x, this->name, u"new");
    set(x, this->owner, z);
    transaction.commit();

    Report const report = listener.committed.at(0);
    EXPECT_THAT(report->getChanged(), UnorderedElementsAre(x, y, z));
    EXPECT_EQ(report->getOldValue(x, this->name),
              Value(StandardTypes::stringMeta, ustring(u"old")));
    EXPECT_EQ(report->getOldValue(x, this->owner).template getValue<ModelElement>(), y);
    EXPECT_THAT(report->getOldValue(y, this->owned)
                    .template getValue<ReferenceCollection&>()
                    .getAllValues(),
                ElementsAre(x));
    EXPECT_TRUE(report->isChanged(x, this->owner));
    EXPECT_FALSE(report->isChanged(x, this->count));
}

TYPED_TEST(Element, IsAsItWasAfterARollback)
{
    ModelElement const p = this->make(), x = this->make(), y = this->make();
    set(x, this->name, u"old");
    set(x, this->parent, p);
    set(x, this->left, y);
    valuesOf(x, this->numbers).genericAdd(Value(StandardTypes::integerMeta, 1));

    Transaction const transaction = this->begin();
    set(x, this->name, u"new");
    clear(x, this->parent);
    clear(x, this->left);
    valuesOf(x, this->numbers).clear();
    y->destroy();
    ModelElement const created = this->make();
    set(created, this->parent, p);
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    EXPECT_EQ(get<ustring>(x, this->name), u"old");
    EXPECT_EQ(targetOf(x, this->parent), p);
    EXPECT_THAT(this->entriesOf(p, this->children), ElementsAre(x));
    EXPECT_TRUE(y);
    EXPECT_EQ(targetOf(x, this->left), y);
    EXPECT_EQ(targetOf(y, this->right), x);
    EXPECT_EQ(valuesOf(x, this->numbers).size(), 1u);
    EXPECT_FALSE(created);
}

TYPED_TEST(Element, ComesBackWithItsContents)
{
    ModelElement const p = this->make(), x = this->make(), y = this->make(), z = this->make();
    set(x, this->parent, p);
    set(p, this->core, y);
    set(z, this->left, p);
    {
        Transaction const transaction = this->begin();
        p->destroy();
        EXPECT_FALSE(p || x || y);
        EXPECT_FALSE(targetOf(z, this->left));
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);
    }

    EXPECT_TRUE(p && x && y);
    EXPECT_EQ(targetOf(x, this->parent), p);
    EXPECT_EQ(targetOf(p, this->core), y);
    EXPECT_EQ(targetOf(z, this->left), p);
}
}  // namespace
}  // namespace testkit
