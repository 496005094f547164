// The contracts of collections, for those of generated classes.
#include "tests/contract/ElementSequenceContract.h"
#include "tests/contract/GeneratedCollectionKinds.h"
#include "tests/contract/KeyedCollectionContract.h"
#include "tests/contract/OwnedCollectionContract.h"
#include "tests/contract/ReferenceCollectionContract.h"
#include "tests/contract/ValueCollectionContract.h"

namespace testkit {
namespace {

using AllKinds =
    ::testing::Types<generated::Numbers, generated::Labels, generated::Words, generated::Colours,
                     generated::Palette, generated::Payments, generated::Prices, generated::Owned,
                     generated::Links, generated::Children, generated::Parts, generated::Marks,
                     generated::Named, generated::Grouped, generated::Listed>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfGeneratedClasses, OwnedCollection, AllKinds, KindNames);

using ValueKinds =
    ::testing::Types<generated::Numbers, generated::Labels, generated::Words, generated::Colours,
                     generated::Palette, generated::Payments, generated::Prices>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfGeneratedClasses, CollectionOfValues, ValueKinds, KindNames);

using ElementKinds =
    ::testing::Types<generated::Owned, generated::Links, generated::Children, generated::Parts,
                     generated::Marks, generated::Named, generated::Grouped, generated::Listed>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfGeneratedClasses, CollectionOfElements, ElementKinds, KindNames);

using SequenceKinds =
    ::testing::Types<generated::Owned, generated::Links, generated::Children, generated::Parts>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfGeneratedClasses, SequenceOfElements, SequenceKinds, KindNames);

using KeyedKinds = ::testing::Types<generated::Named, generated::Grouped, generated::Listed>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfGeneratedClasses, KeyedElements, KeyedKinds, KindNames);
}  // namespace
}  // namespace testkit
