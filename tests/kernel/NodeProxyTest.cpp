// How elements written like generated ones refer to other models.
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tests/support/NodeImpl.h"

#include <gmock/gmock.h>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

class ReferenceBetweenModels : public ::testing::Test
{
protected:
    /// Models that share a constellation take new elements in transactions only.
    static Node make(Model const& model)
    {
        Transaction const transaction = model->beginTransaction(/*revertible=*/false);
        Node const made = Node::create(model);
        transaction.commit();
        return made;
    }
    ProxyId idOf(Node const& node) { return node->getPersistentProxyId(/*omitModel=*/false); }

    Model m_here = Model::create(ModelConstellation());
    Model m_there = Model::create(m_here->getModelConstellation());
    Node m_source = make(m_here);
    Node m_target = make(m_there);
};

TEST_F(ReferenceBetweenModels, FindsTheElementThatItsProxyNames)
{
    Node const proxy = Node::createProxy(m_here, idOf(m_target));
    ASSERT_TRUE(proxy->isProxy());

    m_source->setBuddy(proxy);

    EXPECT_EQ(m_source->getBuddyImpl(), proxy.getImpl());
    EXPECT_EQ(m_source->getBuddy(), m_target);
    EXPECT_EQ(m_source->getBuddyImpl(), m_target.getImpl());
}

TEST_F(ReferenceBetweenModels, KeepsAProxyWhoseTargetDoesNotReferBack)
{
    Node const proxy = Node::createProxy(m_here, idOf(m_target));

    m_source->setLeft(proxy);

    EXPECT_EQ(m_source->getLeft(), proxy);

    m_target->setRight(m_source);

    EXPECT_EQ(m_source->getLeft(), m_target);
}

TEST_F(ReferenceBetweenModels, AnswersReflectionAsFarAsTheTagAllows)
{
    Node const proxy = Node::createProxy(m_here, idOf(m_target));
    meta::Property const& buddy = Node::Impl::BUDDY.property();
    m_source->setBuddy(proxy);

    Value const kept = m_source->getPropertyValue(buddy, ModelElement::Impl::NO_PROXY_RESOLVE);
    Value const found = m_source->getPropertyValue(buddy, ModelElement::Impl::IN_MEMORY_ONLY);

    EXPECT_EQ(kept.getValue<ModelElement>(), proxy);
    EXPECT_EQ(found.getValue<ModelElement>(), m_target);
}

TEST_F(ReferenceBetweenModels, BecomesAProxyWhenTheOtherModelGoes)
{
    ProxyId const id = idOf(m_target);
    m_source->setLeft(m_target);
    m_source->setOwner(m_target);
    m_source->getOwned().push_back(m_target);
    m_source->getLinks().push_back(m_target);
    m_source->getMarks().insert(m_target);

    m_there->destroy();

    EXPECT_FALSE(m_target);
    ASSERT_TRUE(m_source->hasLeft());
    EXPECT_TRUE(m_source->getLeft()->isProxy());
    EXPECT_EQ(m_source->getLeft()->getProxyId().value(), id);
    EXPECT_TRUE(m_source->getOwner()->isProxy());
    EXPECT_THAT(m_source->getOwned().getAllValues(), IsEmpty());
    EXPECT_THAT(m_source->getOwned().getAllValuesAndProxies(), SizeIs(1));
    EXPECT_THAT(m_source->getLinks().getAllValuesAndProxies(), SizeIs(1));
    EXPECT_THAT(m_source->getMarks().getAllValuesAndProxies(), SizeIs(1));
    EXPECT_THAT(m_here->checkInvariants(), IsEmpty());
}

TEST_F(ReferenceBetweenModels, IsDroppedWithItsOwnModel)
{
    m_source->setLeft(m_target);
    m_target->getLinks().push_back(m_source);
    long const before = Node::liveCount();

    m_there->destroy();
    m_target = Node();

    EXPECT_EQ(Node::liveCount(), before + 1);  // a proxy at either end of what is left
    EXPECT_THAT(m_here->checkInvariants(), IsEmpty());
}
}  // namespace testkit
