// The end of reflective elements, and how they come back.
#include "tests/meta/ReflectiveFixture.h"

namespace testkit {
namespace {

class ReflectiveDestruction : public ReflectiveFixture
{
protected:
    meta::Class const node = metamodel.makeClass(u"Node");
    meta::Property const buddy = metamodel.property(node, u"buddy", node);
    meta::Property const left = metamodel.property(node, u"left", node);
    meta::Property const right = metamodel.property(node, u"right", node).opposite(left);
    meta::Property const links = metamodel.property(node, u"links", node).many().ordered();
    meta::Property const backlinks =
        metamodel.property(node, u"backlinks", node).many().opposite(links);
    meta::Property const fans = metamodel.property(node, u"fans", node).many().ordered();
    meta::Property const children =
        metamodel.property(node, u"children", node).many().ordered().composite();
    meta::Property const parent = metamodel.property(node, u"parent", node).opposite(children);
    meta::Property const parts = metamodel.property(node, u"parts", node).many().composite();
    meta::Property const core = metamodel.property(node, u"core", node).composite();
};

TEST_F(ReflectiveDestruction, LeavesNoReferenceWithAnOtherEnd)
{
    ModelElement const x = make(node), a = make(node), b = make(node), c = make(node);
    set(x, left, a);
    genericOf(x, links).genericAdd(b);
    genericOf(c, links).genericAdd(x);

    x->destroy();

    EXPECT_FALSE(x);
    EXPECT_FALSE(targetOf(a, right));
    EXPECT_THAT(entriesOf(b, backlinks), IsEmpty());
    EXPECT_THAT(entriesOf(c, links), IsEmpty());
}

TEST_F(ReflectiveDestruction, LeavesItsContainer)
{
    ModelElement const p = make(node), x = make(node), y = make(node);
    set(x, parent, p);
    set(p, core, y);

    x->destroy();
    y->destroy();

    EXPECT_THAT(entriesOf(p, children), IsEmpty());
    EXPECT_FALSE(targetOf(p, core));
    EXPECT_TRUE(p);
}

TEST_F(ReflectiveDestruction, TakesItsContentsAlong)
{
    ModelElement const p = make(node), x = make(node), y = make(node), z = make(node),
                       deep = make(node);
    set(x, parent, p);
    genericOf(p, parts).genericAdd(y);
    set(p, core, z);
    set(deep, parent, x);

    p->destroy();

    for (ModelElement const& element : {p, x, y, z, deep})
        EXPECT_FALSE(element);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ReflectiveDestruction, LeavesDeadHandlesInReferencesWithoutAnOtherEnd)
{
    ModelElement const x = make(node), a = make(node);
    set(a, buddy, x);
    genericOf(a, fans).genericAdd(x);

    x->destroy();

    EXPECT_FALSE(targetOf(a, buddy));
    EXPECT_FALSE(has(a, buddy));
    EXPECT_EQ(genericOf(a, fans).genericSize(), 1u);
}

TEST_F(ReflectiveDestruction, EmptiesItsOwnReferences)
{
    ModelElement x = make(node), y = make(node);
    set(x, buddy, y);
    set(y, buddy, x);
    genericOf(x, fans).genericAdd(y);

    x->destroy();
    y->destroy();

    EXPECT_EQ(x->getRefCount(), 1u) << "the handle alone";
    EXPECT_EQ(y->getRefCount(), 1u) << "the handle alone";
}

TEST_F(ReflectiveDestruction, IsTakenBackByARollback)
{
    ModelElement const p = make(node), x = make(node), y = make(node), z = make(node),
                       a = make(node);
    set(x, parent, p);
    genericOf(p, parts).genericAdd(y);
    set(p, core, z);
    set(p, left, a);
    set(a, buddy, p);
    genericOf(p, links).genericAdd(a);
    genericOf(p, fans).genericAdd(a);
    Transaction const transaction = begin();

    p->destroy();
    EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

    for (ModelElement const& element : {p, x, y, z, a})
        EXPECT_TRUE(element);
    EXPECT_THAT(entriesOf(p, children), ElementsAre(x));
    EXPECT_THAT(entriesOf(p, parts), ElementsAre(y));
    EXPECT_EQ(targetOf(p, core), z);
    EXPECT_EQ(z->container(), p);
    EXPECT_EQ(targetOf(x, parent), p);
    EXPECT_EQ(targetOf(a, right), p);
    EXPECT_EQ(targetOf(a, buddy), p);
    EXPECT_THAT(entriesOf(a, backlinks), ElementsAre(p));
    EXPECT_THAT(entriesOf(p, fans), ElementsAre(a));
}

TEST_F(ReflectiveDestruction, OfAChainOfAnyDepthNeedsLittleStack)
{
    ModelElement top = make(node), bottom = top;
    for (int depth = 0; depth < 20'000; ++depth)
    {
        ModelElement const child = make(node);
        genericOf(bottom, children).genericAdd(child);
        bottom = child;
    }

    top->destroy();

    EXPECT_FALSE(bottom);
    EXPECT_EQ(model->getElementCount(), 0u);
}

TEST_F(ReflectiveDestruction, OfTheModelDestroysAllElements)
{
    Model other = Model::create(ModelConstellation());
    ModelElement const p = ModelElement::createReflective(other, node);
    ModelElement const x = ModelElement::createReflective(other, node);
    set(x, parent, p);
    set(x, left, p);
    genericOf(x, links).genericAdd(p);

    other->destroy();

    EXPECT_FALSE(p);
    EXPECT_FALSE(x);
}
}  // namespace
}  // namespace testkit
