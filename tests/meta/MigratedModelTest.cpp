// How models move between constellations.
#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tests/meta/ExtensionFixture.h"

namespace testkit {
namespace {

class MigratedModel : public ::testing::Test
{
protected:
    ModelConstellation m_old = ModelConstellation::create();
    ModelConstellation m_new = ModelConstellation::create();
    Model m_model = Model::create(m_old);
    Node m_node = Node::create(m_model);
};

TEST_F(MigratedModel, IsInTheOtherConstellation)
{
    m_model->migrateToConstellation(m_new);

    EXPECT_EQ(m_model->getModelConstellation(), m_new);
    EXPECT_EQ(m_new->peekModel(m_model->getModelURI()), m_model);
    EXPECT_FALSE(m_old->peekModel(m_model->getModelURI()));
    EXPECT_TRUE(m_node);
}

TEST_F(MigratedModel, StaysWhereItIs)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
    m_model->migrateToConstellation(m_old);
    EXPECT_EQ(m_model->getModelConstellation(), m_old);
    transaction.commit();
}

TEST_F(MigratedModel, IsFreeAndAlone)
{
    {
        Transaction const transaction = m_model->beginTransaction(/*revertible=*/false);
        EXPECT_RAISES(messages::CannotMigrateModel, m_model->migrateToConstellation(m_new));
        transaction.commit();
    }
    EXPECT_RAISES(messages::CannotMigrateModel,
                  m_model->migrateToConstellation(ModelConstellation()));
    ModelConstellation const dead = ModelConstellation::create();
    dead->destroy();
    EXPECT_RAISES(messages::CannotMigrateModel, m_model->migrateToConstellation(dead));
    Model const transient = Model::createTransientModel();
    EXPECT_RAISES(messages::CannotMigrateModel, transient->migrateToConstellation(m_new));
    Model const second = Model::create(m_old);
    EXPECT_RAISES(messages::CannotMigrateModel, m_model->migrateToConstellation(m_new));

    EXPECT_EQ(m_model->getModelConstellation(), m_old);
    second->destroy();
    EXPECT_NO_THROW(m_model->migrateToConstellation(m_new));
}

TEST_F(MigratedModel, IsRefusedByAShallowTransactionAndByATakenLocation)
{
    Model const present = Model::create(m_new);
    {
        Transaction const transaction = present->beginTransaction(/*revertible=*/false);
        EXPECT_RAISES(messages::CannotJoinShallowTransaction,
                      m_model->migrateToConstellation(m_new));
        transaction.commit();
    }
    m_model->setModelURI(u"file:///same");
    present->setModelURI(u"file:///same");
    EXPECT_RAISES(messages::UniquenessConstraint, m_model->migrateToConstellation(m_new));

    EXPECT_EQ(m_model->getModelConstellation(), m_old);
}

TEST_F(MigratedModel, KeepsItsExtensions)
{
    m_model->extendMetaclass(Node::metaClass(), prototype(u"shelf"), number(0));
    m_node->setExtension(u"shelf", number(1));

    m_model->migrateToConstellation(m_new);

    EXPECT_EQ(m_node->getExtension(u"shelf"), number(1));
}
}  // namespace
}  // namespace testkit
