// The contracts of collections, for those of reflective elements.
#include "tests/contract/ElementSequenceContract.h"
#include "tests/contract/KeyedCollectionContract.h"
#include "tests/contract/OwnedCollectionContract.h"
#include "tests/contract/ReferenceCollectionContract.h"
#include "tests/contract/ReflectiveCollectionKinds.h"
#include "tests/contract/ValueCollectionContract.h"

namespace testkit {
namespace {

using AllKinds =
    ::testing::Types<ReflectiveNumbers, ReflectiveLabels, ReflectiveWords, ReflectiveOwned,
                     ReflectiveLinks, ReflectiveChildren, ReflectiveParts, ReflectiveMarks,
                     ReflectiveByName, ReflectiveGrouped>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfReflectiveElements, OwnedCollection, AllKinds, KindNames);

using ValueKinds = ::testing::Types<ReflectiveNumbers, ReflectiveLabels, ReflectiveWords>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfReflectiveElements, CollectionOfValues, ValueKinds, KindNames);

using ElementKinds =
    ::testing::Types<ReflectiveOwned, ReflectiveLinks, ReflectiveChildren, ReflectiveParts,
                     ReflectiveMarks, ReflectiveByName, ReflectiveGrouped>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfReflectiveElements, CollectionOfElements, ElementKinds, KindNames);

using SequenceKinds =
    ::testing::Types<ReflectiveOwned, ReflectiveLinks, ReflectiveChildren, ReflectiveParts>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfReflectiveElements, SequenceOfElements, SequenceKinds, KindNames);

using KeyedKinds = ::testing::Types<ReflectiveByName, ReflectiveGrouped>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfReflectiveElements, KeyedElements, KeyedKinds, KindNames);
}  // namespace
}  // namespace testkit
