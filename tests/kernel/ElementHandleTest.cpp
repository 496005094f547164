#include "tarnkiln/kernel/ElementHandle.h"
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/meta/Class.h"
#include "tests/support/InvalidationLog.h"

#include <boost/uuid/uuid_io.hpp>
#include <gtest/gtest.h>

#include <set>
#include <thread>

namespace {

using namespace tarn::kiln;
using testkit::InvalidationLog;
using Validity = ElementImpl::ElementValidity;

UUID uuidOf(std::uint8_t number)
{
    UUID result{};
    result.data[15] = number;
    return result;
}

/// The smallest thing that stands behind a handle.
class Probe : public ElementImpl
{
public:
    static inline long inMemory = 0;

    explicit Probe(UUID const& id = {}, Validity validity = Validity::Valid)
        : ElementImpl(id, validity)
    {
        ++inMemory;
    }
    ~Probe() override { --inMemory; }

    Model getModel() const override { return Model(); }
    meta::Class const& getMetaClass() const override
    {
        static meta::Class const none;
        return none;
    }
    void setValidity(Validity validity) { m_validity = validity; }

    std::vector<ElementHandle> held;
};

class Handle : public ElementHandle
{
public:
    Handle() = default;
    explicit Handle(Probe* probe) : ElementHandle(probe) {}
    Probe* operator->() const { return static_cast<Probe*>(m_impl); }
};

class HandleTest : public ::testing::Test
{
protected:
    ~HandleTest() override { EXPECT_EQ(Probe::inMemory, m_before); }

private:
    long const m_before = Probe::inMemory;
};

using AHandle = HandleTest;
using AnInvalidatedObject = HandleTest;
using AReleasedChain = HandleTest;
using AnElementImpl = HandleTest;
using AnInvalidateCallback = HandleTest;

// ---------------------------------------------------------------------------- handles

TEST_F(AHandle, IsOnePointer)
{
    EXPECT_EQ(sizeof(ElementHandle), sizeof(void*));
    EXPECT_EQ(sizeof(Model), sizeof(void*));
    EXPECT_EQ(sizeof(meta::Class), sizeof(void*));
}

TEST_F(AHandle, IsEmptyByDefault)
{
    Handle const handle;

    EXPECT_FALSE(handle);
    EXPECT_EQ(handle.getElementImpl(), nullptr);
    EXPECT_EQ(handle, Handle());
}

TEST_F(AHandle, HoldsOneReference)
{
    auto* const probe = new Probe;
    EXPECT_EQ(probe->getRefCount(), 0u);

    {
        Handle const handle(probe);
        EXPECT_EQ(probe->getRefCount(), 1u);
    }

    EXPECT_EQ(Probe::inMemory, 0);
}

TEST_F(AHandle, SharesItsObjectWithCopies)
{
    Handle const first(new Probe);
    {
        Handle const second(first);
        EXPECT_EQ(first->getRefCount(), 2u);
        EXPECT_EQ(first, second);
        EXPECT_EQ(second.getElementImpl(), first.getElementImpl());
    }

    EXPECT_EQ(first->getRefCount(), 1u);
    EXPECT_TRUE(first);
}

TEST_F(AHandle, CopiesAndAssignsEmptiness)
{
    Handle empty;
    Handle copy(empty);
    Handle full(new Probe);

    EXPECT_FALSE(copy);
    full = empty;
    EXPECT_FALSE(full);
    EXPECT_EQ(full.getElementImpl(), nullptr);
    EXPECT_EQ(Probe::inMemory, 0);
    empty = copy;
    EXPECT_EQ(empty.getElementImpl(), nullptr);
}

TEST_F(AHandle, GivesItsOldObjectBackWhenAssignedAnother)
{
    Handle first(new Probe);
    Handle const second(new Probe);

    first = second;

    EXPECT_EQ(first, second);
    EXPECT_EQ(second->getRefCount(), 2u);
    EXPECT_EQ(Probe::inMemory, 1);
}

TEST_F(AHandle, SurvivesCopyAssignmentToItself)
{
    Handle handle(new Probe);
    Handle const& same = handle;

    handle = same;

    EXPECT_TRUE(handle);
    EXPECT_EQ(handle->getRefCount(), 1u);
}

TEST_F(AHandle, TakesTheNewReferenceBeforeItGivesTheOldOneBack)
{
    Handle handle(new Probe);
    auto* const next = new Probe;
    handle->held.push_back(Handle(next));
    ElementHandle const* const insideTheOldObject = &handle->held.front();

    static_cast<ElementHandle&>(handle) = *insideTheOldObject;

    EXPECT_EQ(handle.getElementImpl(), next);
    EXPECT_EQ(next->getRefCount(), 1u);
    EXPECT_EQ(Probe::inMemory, 1);
}

TEST_F(AHandle, IsEmptyAfterAnotherWasConstructedFromItByMoving)
{
    Handle source(new Probe);
    Handle const target(std::move(source));

    EXPECT_EQ(source.getElementImpl(), nullptr);
    EXPECT_EQ(target->getRefCount(), 1u);
}

TEST_F(AHandle, SwapsTargetsInAMoveAssignment)
{
    auto* const one = new Probe;
    auto* const two = new Probe;
    Handle first(one);
    Handle second(two);

    first = std::move(second);

    EXPECT_EQ(first.getElementImpl(), two);
    EXPECT_EQ(second.getElementImpl(), one);
    EXPECT_EQ(one->getRefCount(), 1u);
    EXPECT_EQ(two->getRefCount(), 1u);
}

TEST_F(AHandle, KeepsTheOldTargetOfAMoveAssignmentUntilTheSourceDies)
{
    Handle target(new Probe);
    {
        Handle source(new Probe);
        target = std::move(source);
        EXPECT_EQ(Probe::inMemory, 2);
    }

    EXPECT_EQ(Probe::inMemory, 1);
}

TEST_F(AHandle, SurvivesMoveAssignmentToItself)
{
    Handle handle(new Probe);
    Handle& same = handle;

    handle = std::move(same);

    EXPECT_TRUE(handle);
    EXPECT_EQ(handle->getRefCount(), 1u);
}

TEST_F(AHandle, EqualsHandlesOfTheSameObjectOnly)
{
    UUID const id = uuidOf(7);
    Handle const first(new Probe(id));
    Handle const twin(new Probe(id));

    EXPECT_EQ(first, Handle(first));
    EXPECT_NE(first, twin);
    EXPECT_NE(first, Handle());
}

TEST_F(AHandle, IsFalseForAnInvalidObjectAndTrueForAllOthers)
{
    Handle const handle(new Probe);
    for (Validity const validity : {Validity::Constructing, Validity::Valid,
                                    Validity::ModelDestroying, Validity::BuilderProxy})
    {
        handle->setValidity(validity);
        EXPECT_TRUE(handle) << static_cast<int>(validity);
    }

    handle->setValidity(Validity::Invalid);

    EXPECT_FALSE(handle);
}

// ---------------------------------------------------------------------------- the object

TEST_F(AnElementImpl, HasTheValidityValuesThatHostsKnow)
{
    EXPECT_EQ(static_cast<int>(Validity::Invalid), 0);
    EXPECT_EQ(static_cast<int>(Validity::Constructing), 1);
    EXPECT_EQ(static_cast<int>(Validity::Valid), 2);
    EXPECT_EQ(static_cast<int>(Validity::ModelDestroying), 3);
    EXPECT_EQ(static_cast<unsigned char>(Validity::BuilderProxy), 255);
    EXPECT_EQ(sizeof(Validity), 1u);
    EXPECT_EQ(ElementImpl::REFCOUNT_DELETING, 0xDEADu);
}

TEST_F(AnElementImpl, KeepsTheUuidItIsGiven)
{
    EXPECT_EQ(Handle(new Probe(uuidOf(9)))->getUuid(), uuidOf(9));
}

TEST_F(AnElementImpl, TakesAFreshRandomUuidForTheNilOne)
{
    Handle const first(new Probe(UUID{}));
    Handle const second(new Probe(UUID{}));

    EXPECT_FALSE(first->getUuid().is_nil());
    EXPECT_EQ(first->getUuid().version(), boost::uuids::uuid::version_random_number_based);
    EXPECT_NE(first->getUuid(), second->getUuid());
}

TEST_F(AnElementImpl, LivesUntilItsLastReferenceIsGivenBack)
{
    auto* const probe = new Probe;
    probe->addRef();
    probe->addRef();
    EXPECT_EQ(probe->getRefCount(), 2u);

    probe->removeRef();
    EXPECT_EQ(Probe::inMemory, 1);
    probe->removeRef();

    EXPECT_EQ(Probe::inMemory, 0);
}

TEST_F(AnInvalidatedObject, StaysInMemoryWithItsUuidAndCounts)
{
    Handle const handle(new Probe(uuidOf(3)));

    handle->invalidate();
    handle->addRef();
    handle->removeRef();
    Handle const copy = handle;

    EXPECT_FALSE(copy);
    EXPECT_EQ(copy->getUuid(), uuidOf(3));
    EXPECT_EQ(handle->getRefCount(), 2u);
    EXPECT_EQ(Probe::inMemory, 1);
}

TEST_F(AnInvalidatedObject, TestsTrueAgainInOldHandlesWhenItIsBroughtBack)
{
    Handle const handle(new Probe);
    handle->invalidate();

    handle->setValidity(Validity::Valid);

    EXPECT_TRUE(handle);
}

// ---------------------------------------------------------------------------- callback

TEST_F(AnInvalidateCallback, IsToldOfAnInvalidatedElementWithoutACollection)
{
    InvalidationLog const log;
    Handle const handle(new Probe);

    handle->invalidate();

    ASSERT_EQ(log.calls().size(), 1u);
    EXPECT_EQ(log.calls()[0], InvalidationLog::Call(handle.getElementImpl(), nullptr));
}

TEST_F(AnInvalidateCallback, FindsTheElementInvalidAlready)
{
    static Validity seen;
    class Watched : public Probe
    {
    public:
        void invalidate() override
        {
            Probe::invalidate();
            seen = getValidity();
        }
    };
    InvalidationLog const log;
    Handle const handle(new Watched);

    handle->invalidate();

    EXPECT_EQ(seen, Validity::Invalid);
    EXPECT_EQ(log.deathsOf(handle.getElementImpl()), 1);
}

TEST_F(AnInvalidateCallback, IsNotToldOfAMereDeletion)
{
    InvalidationLog const log;

    Handle(new Probe);

    EXPECT_TRUE(log.calls().empty());
}

TEST_F(AnInvalidateCallback, StaysWhenASecondOneIsInstalled)
{
    static int callsOfTheSecond;
    callsOfTheSecond = 0;
    InvalidationLog const log;

    ElementImpl::setInvalidateCallback(
        [](ElementImpl*, AbstractOwnedCollection*) { ++callsOfTheSecond; });
    ElementImpl::setInvalidateCallback(nullptr);
    Handle(new Probe)->invalidate();

    EXPECT_EQ(callsOfTheSecond, 0);
    EXPECT_EQ(log.calls().size(), 1u);
}

// ---------------------------------------------------------------------------- UUIDs

TEST(AGeneratedUuid, IsOfVersion4AndOfTheStandardVariant)
{
    for (int i = 0; i < 1000; ++i)
    {
        UUID const id = ElementImpl::generateNewUuid();
        ASSERT_EQ(id.data[6] & 0xF0, 0x40) << id;
        ASSERT_EQ(id.data[8] & 0xC0, 0x80) << id;
    }
}

TEST(AGeneratedUuid, IsRandomInAllOtherBits)
{
    UUID everSet{};
    UUID everClear{};
    for (int i = 0; i < 1000; ++i)
    {
        UUID const id = ElementImpl::generateNewUuid();
        for (std::size_t byte = 0; byte < UUID::static_size(); ++byte)
        {
            everSet.data[byte] |= id.data[byte];
            everClear.data[byte] |= static_cast<std::uint8_t>(~id.data[byte]);
        }
    }

    for (std::size_t byte = 0; byte < UUID::static_size(); ++byte)
    {
        EXPECT_EQ(everSet.data[byte], byte == 6 ? 0x4F : byte == 8 ? 0xBF : 0xFF) << byte;
        EXPECT_EQ(everClear.data[byte], byte == 6 ? 0xBF : byte == 8 ? 0x7F : 0xFF) << byte;
    }
}

TEST(AGeneratedUuid, DiffersFromAllOthersOnAllThreads)
{
    constexpr int EACH = 5000;
    std::vector<std::vector<UUID>> made(4);
    std::vector<std::thread> threads;
    for (std::vector<UUID>& mine : made)
        threads.emplace_back([&mine] {
            for (int i = 0; i < EACH; ++i)
                mine.push_back(ElementImpl::generateNewUuid());
        });
    for (std::thread& thread : threads)
        thread.join();

    std::set<UUID> all;
    for (std::vector<UUID> const& mine : made)
        all.insert(mine.begin(), mine.end());
    EXPECT_EQ(all.size(), made.size() * EACH);
}

// ---------------------------------------------------------------------------- chains

Handle makeChain(int length)
{
    Handle head(new Probe);
    for (int i = 1; i < length; ++i)
    {
        Handle next(new Probe);
        next->held.push_back(head);
        head = next;
    }
    return head;
}

TEST_F(AReleasedChain, OfAnyLengthNeedsLittleStack)
{
    {
        Handle const head = makeChain(300'000);
        EXPECT_EQ(Probe::inMemory, 300'000);
    }

    EXPECT_EQ(Probe::inMemory, 0);
}

TEST_F(AReleasedChain, StopsAtWhatIsStillHeld)
{
    ElementHandle middle;
    {
        Handle const tail = makeChain(1'000);
        middle = tail;
        Handle head = tail;
        for (int i = 0; i < 1'000; ++i)
        {
            Handle next(new Probe);
            next->held.push_back(head);
            head = next;
        }
        EXPECT_EQ(Probe::inMemory, 2'000);
    }

    EXPECT_EQ(Probe::inMemory, 1'000);
    EXPECT_TRUE(middle);
    EXPECT_EQ(middle.getElementImpl()->getRefCount(), 1u);
}

TEST_F(AReleasedChain, MayBranchAndMeetAgain)
{
    {
        Handle top(new Probe);
        for (int level = 0; level < 2'000; ++level)
        {
            Handle left(new Probe);
            Handle right(new Probe);
            Handle next(new Probe);
            left->held.push_back(top);
            right->held.push_back(top);
            next->held.push_back(left);
            next->held.push_back(right);
            top = next;
        }
        EXPECT_EQ(Probe::inMemory, 6'001);
    }

    EXPECT_EQ(Probe::inMemory, 0);
}
}  // namespace
