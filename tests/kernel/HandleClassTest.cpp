#include "tarnkiln/kernel/ModelConstellationImpl.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/PlainElement.h"

#include <gmock/gmock.h>

#include <type_traits>
#include <unordered_set>

namespace {

using namespace tarn::kiln;
using namespace testkit;

/// Makes objects for each handle class.
template <class Handle> struct Maker
{
    Model model = Model::createTransientModel();
    Handle make() const { return Handle::create(model); }
};
template <> struct Maker<Model>
{
    Model make() const { return Model::createTransientModel(); }
};
template <> struct Maker<ModelConstellation>
{
    ModelConstellation make() const { return ModelConstellation::create(); }
};
template <> struct Maker<ModelElement>
{
    Model model = Model::createTransientModel();
    ModelElement make() const { return Plain::create(model); }
};

template <class T> class EveryHandleClass : public ::testing::Test
{
protected:
    Maker<T> const maker{};
};

using HandleClasses =
    ::testing::Types<Model, ModelConstellation, ModelElement, Plain, Node, meta::Package>;
TYPED_TEST_SUITE(EveryHandleClass, HandleClasses);

TYPED_TEST(EveryHandleClass, IsOnePointerThatIsEmptyByDefault)
{
    TypeParam const handle;

    EXPECT_EQ(sizeof(TypeParam), sizeof(void*));
    EXPECT_FALSE(handle);
    EXPECT_EQ(handle.getImpl(), nullptr);
    EXPECT_EQ(handle, TypeParam());
    EXPECT_EQ(TypeParam(static_cast<typename TypeParam::Impl*>(nullptr)).getImpl(), nullptr);
}

TYPED_TEST(EveryHandleClass, SharesAndCounts)
{
    TypeParam const first = this->maker.make();
    auto const before = first->getRefCount();
    {
        TypeParam const second(first);
        TypeParam third;
        third = second;
        EXPECT_EQ(first, third);
        EXPECT_EQ(first->getRefCount(), before + 2);
    }

    EXPECT_EQ(first->getRefCount(), before);
}

TYPED_TEST(EveryHandleClass, MovesWithoutCounting)
{
    TypeParam first = this->maker.make();
    TypeParam second = this->maker.make();
    auto* const one = first.getImpl();
    auto* const two = second.getImpl();
    auto const before = one->getRefCount();

    first = std::move(second);
    EXPECT_EQ(first.getImpl(), two);
    EXPECT_EQ(second.getImpl(), one);
    TypeParam const third(std::move(second));

    EXPECT_EQ(third.getImpl(), one);
    EXPECT_EQ(second.getImpl(), nullptr);
    EXPECT_EQ(one->getRefCount(), before);
    static_assert(std::is_nothrow_move_constructible_v<TypeParam>);
    static_assert(std::is_nothrow_move_assignable_v<TypeParam>);
}

TYPED_TEST(EveryHandleClass, IsFalseForADestroyedObjectWhichStaysReadable)
{
    TypeParam const handle = this->maker.make();
    UUID const id = handle->getUuid();
    ASSERT_TRUE(handle);

    handle->destroy();
    TypeParam const copy = handle;

    EXPECT_FALSE(handle);
    EXPECT_FALSE(copy);
    EXPECT_EQ(copy, handle);
    EXPECT_NE(copy, TypeParam());
    EXPECT_EQ(copy->getUuid(), id);
}

TYPED_TEST(EveryHandleClass, EqualsHandlesOfTheSameObjectOnly)
{
    TypeParam const first = this->maker.make();
    TypeParam const second = this->maker.make();

    EXPECT_EQ(first, first);
    EXPECT_NE(first, second);
    EXPECT_NE(first, TypeParam());
}

TYPED_TEST(EveryHandleClass, CanBeLookedUpInHashedContainers)
{
    TypeParam const first = this->maker.make();
    TypeParam const second = this->maker.make();
    std::unordered_set<TypeParam> const set{first, first, TypeParam()};

    EXPECT_EQ(set.size(), 2u);
    EXPECT_EQ(set.count(first), 1u);
    EXPECT_EQ(set.count(second), 0u);
    EXPECT_EQ(set.count(TypeParam()), 1u);
}

TEST(HandlesOfElements, HashByTheirElementWhateverTheirClass)
{
    Model const model = Model::createTransientModel();
    Plain const first = Plain::create(model);
    Plain const second = Plain::create(model);
    std::unordered_set<ModelElement> const set{first, second, ModelElement(first), ModelElement()};

    EXPECT_EQ(set.size(), 3u);
    EXPECT_EQ(set.count(ModelElement(second.getImpl())), 1u);
    EXPECT_EQ(std::hash<ModelElement>()(ModelElement()), 0u);
    EXPECT_EQ(std::hash<Plain>()(first), std::hash<ModelElement>()(first));
}
}  // namespace
