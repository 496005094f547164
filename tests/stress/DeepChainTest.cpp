// A chain of elements, each in the one before, needs no more stack the longer it is, whatever is
// done to it. The tests run on a thread with little stack, so that they can't pass by luck.
//
// TARNKILN_CHAIN_LENGTH in the environment makes the chains longer.
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/RuntimeMetamodel.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

#include <cstdlib>
#include <functional>
#include <pthread.h>

namespace {

using namespace testkit;
using testing::IsEmpty;

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
constexpr std::size_t STACK = 2 * 1024 * 1024;  // instrumented frames are several times larger
#else
constexpr std::size_t STACK = 256 * 1024;
#endif

/// Unless told otherwise, so long that one call for each element would be too much: the least that
/// a call takes is 16 bytes.
std::size_t chainLength()
{
    char const* const wanted = std::getenv("TARNKILN_CHAIN_LENGTH");
    return wanted ? std::strtoul(wanted, nullptr, 10) : STACK / 16;
}

/// Runs `body` on a thread with a stack of that size, to its end.
void onLittleStack(std::function<void()> const& body)
{
    pthread_attr_t attributes;
    ASSERT_EQ(pthread_attr_init(&attributes), 0);
    ASSERT_EQ(pthread_attr_setstacksize(&attributes, STACK), 0);
    pthread_t thread;
    auto const run = [](void* given) -> void* {
        (*static_cast<std::function<void()> const*>(given))();
        return nullptr;
    };
    ASSERT_EQ(pthread_create(&thread, &attributes, run, const_cast<std::function<void()>*>(&body)),
              0);
    pthread_attr_destroy(&attributes);
    ASSERT_EQ(pthread_join(thread, nullptr), 0);
}

// ---------------------------------------------------------------------------- kinds of links

struct NodeLinks
{
    static ModelElement make(Model const& model) { return Node::create(model); }
};

struct NodesInSequences : NodeLinks
{
    static void contain(ModelElement const& container, ModelElement const& child)
    {
        Node::cast(container)->getChildren().push_back(Node::cast(child));
    }
};

struct NodesInReferences : NodeLinks
{
    static void contain(ModelElement const& container, ModelElement const& child)
    {
        Node::cast(container)->setBody(Node::cast(child));
    }
};

struct NodesInMaps : NodeLinks
{
    static void contain(ModelElement const& container, ModelElement const& child)
    {
        Node::cast(container)->getByName().insert(Node::cast(child));
    }
};

struct NodesByTheirContainer : NodeLinks
{
    static void contain(ModelElement const& container, ModelElement const& child)
    {
        Node::cast(child)->setParent(Node::cast(container));
    }
};

/// A class that exists only as data, with a contained element of each shape.
struct Box
{
    static Box const& get()
    {
        static Box const box;
        return box;
    }

    RuntimeMetamodel metamodel;
    meta::Class const box = metamodel.makeClass(u"Box");
    meta::Property const children =
        metamodel.property(box, u"children", box).many().ordered().composite();
    meta::Property const parent = metamodel.property(box, u"parent", box).opposite(children);
    meta::Property const core = metamodel.property(box, u"core", box).composite();
};

struct BoxLinks
{
    static ModelElement make(Model const& model)
    {
        return ModelElement::createReflective(model, Box::get().box);
    }
};

struct BoxesInSequences : BoxLinks
{
    static void contain(ModelElement const& container, ModelElement const& child)
    {
        referencesOf(container, Box::get().children).getGenericInterface()->genericAdd(child);
    }
};

struct BoxesInReferences : BoxLinks
{
    static void contain(ModelElement const& container, ModelElement const& child)
    {
        set(container, Box::get().core, child);
    }
};

// ---------------------------------------------------------------------------- the chain

template <class Links> class DeepChain : public testing::Test
{
protected:
    DeepChain() { Links::make(Model::createTransientModel()); }  // what is made once for all
    ~DeepChain() override { EXPECT_EQ(Node::liveCount(), m_nodes) << "elements stayed in memory"; }

    /// A model with a chain in it.
    struct Chain
    {
        Chain()
        {
            Transaction const transaction = model->beginTransaction(/*revertible=*/false);
            extend(length - 1);
            transaction.commit();
        }
        /// From the bottom upward, since a container that lies deep is searched for a circle.
        void extend(std::size_t count)
        {
            for (; count != 0; --count)
            {
                ModelElement const next = Links::make(model);
                Links::contain(next, top);
                top = next;
            }
        }
        Transaction begin() const { return model->beginTransaction(/*revertible=*/true); }

        std::size_t const length = chainLength();
        Model model = Model::create(ModelConstellation());
        ModelElement bottom = Links::make(model);
        ModelElement top = bottom;
    };

private:
    long const m_nodes = Node::liveCount();
};

struct LinkNames
{
    template <class Links> static std::string GetName(int /*index*/)
    {
        std::string const name = testing::internal::GetTypeName<Links>();
        return name.substr(name.rfind(':') + 1);
    }
};

using AllLinks = testing::Types<NodesInSequences, NodesInReferences, NodesInMaps,
                                NodesByTheirContainer, BoxesInSequences, BoxesInReferences>;
TYPED_TEST_SUITE(DeepChain, AllLinks, LinkNames);

TYPED_TEST(DeepChain, IsReleasedWithItsModel)
{
    onLittleStack([] {
        typename TestFixture::Chain const chain;
        EXPECT_EQ(chain.model->getElementCount(), chain.length);
        EXPECT_THAT(chain.model->checkInvariants(), IsEmpty());
    });
}

TYPED_TEST(DeepChain, IsReleasedAfterItsModel)
{
    onLittleStack([] {
        typename TestFixture::Chain chain;

        chain.model = Model();
        chain.top = ModelElement();

        EXPECT_FALSE(chain.bottom);
    });
}

TYPED_TEST(DeepChain, IsMovedToAnotherContainerAndBack)
{
    onLittleStack([] {
        typename TestFixture::Chain const chain;
        ModelElement const other = TypeParam::make(chain.model);
        Transaction const transaction = chain.begin();

        TypeParam::contain(other, chain.top);
        EXPECT_EQ(chain.top->container(), other);
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

        EXPECT_FALSE(chain.top->container());
        TypeParam::contain(other, chain.top);
        EXPECT_EQ(chain.top->container(), other);
    });
}

TYPED_TEST(DeepChain, IsMovedToAnotherModel)
{
    onLittleStack([] {
        typename TestFixture::Chain const chain;
        Model const target = Model::create(ModelConstellation());

        chain.model->moveAllContentsTo(target);

        EXPECT_EQ(target->getElementCount(), chain.length);
        EXPECT_EQ(chain.bottom->getModel(), target);
        EXPECT_THAT(target->checkInvariants(), IsEmpty());
    });
}

TYPED_TEST(DeepChain, IsDestroyedAndBroughtBack)
{
    onLittleStack([] {
        typename TestFixture::Chain const chain;
        Transaction const transaction = chain.begin();

        chain.top->destroy();
        EXPECT_FALSE(chain.bottom);
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

        EXPECT_TRUE(chain.bottom);
        EXPECT_EQ(chain.model->getElementCount(), chain.length);
        EXPECT_THAT(chain.model->checkInvariants(), IsEmpty());
        chain.top->destroy();
        EXPECT_EQ(chain.model->getElementCount(), 0u);
    });
}

TYPED_TEST(DeepChain, IsDestroyedWhileOnlyARecordHoldsIt)
{
    onLittleStack([] {
        typename TestFixture::Chain chain;
        ScriptedListener listener;
        listen(chain.model, listener);
        Transaction const transaction = chain.begin();

        chain.top->destroy();
        chain.top = ModelElement();
        chain.bottom = ModelElement();
        EXPECT_EQ(transaction.commit(), TransactionResult::Committed);

        EXPECT_EQ(listener.committed.size(), 1u);
        chain.model->removeListener(&listener);
    });
}

TYPED_TEST(DeepChain, IsRolledBackOutOfExistence)
{
    onLittleStack([] {
        typename TestFixture::Chain chain;
        Transaction const transaction = chain.begin();

        chain.extend(chain.length);
        EXPECT_EQ(chain.model->getElementCount(), 2 * chain.length);
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

        EXPECT_FALSE(chain.top);
        EXPECT_EQ(chain.model->getElementCount(), chain.length);
    });
}

TYPED_TEST(DeepChain, IsDestroyedWithAllContents)
{
    onLittleStack([] {
        typename TestFixture::Chain const chain;
        Transaction const transaction = chain.begin();

        chain.model->destroyAllContents();
        EXPECT_FALSE(chain.top);
        EXPECT_EQ(transaction.rollBack(), TransactionResult::RolledBack);

        EXPECT_TRUE(chain.bottom);
        chain.model->destroyAllContents();
        EXPECT_EQ(chain.model->getElementCount(), 0u);
    });
}

TYPED_TEST(DeepChain, IsDestroyedWithItsModel)
{
    onLittleStack([] {
        typename TestFixture::Chain const chain;

        chain.model->destroy();

        EXPECT_FALSE(chain.bottom);
    });
}
}  // namespace
