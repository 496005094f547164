// The contracts of collections, for those of hand-written classes.
#include "tests/contract/CollectionKinds.h"
#include "tests/contract/ElementSequenceContract.h"
#include "tests/contract/KeyedCollectionContract.h"
#include "tests/contract/OwnedCollectionContract.h"
#include "tests/contract/ReferenceCollectionContract.h"
#include "tests/contract/ValueCollectionContract.h"

namespace testkit {
namespace {

using AllKinds = ::testing::Types<Numbers, Labels, Words, Owned, Links, Backlinks, Children, Parts,
                                  Marks, MarkedBy, ByName, Grouped, LinksToNothing>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfNodes, OwnedCollection, AllKinds, KindNames);

using ValueKinds = ::testing::Types<Numbers, Labels, Words>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfNodes, CollectionOfValues, ValueKinds, KindNames);

using ElementKinds =
    ::testing::Types<Owned, Links, Backlinks, Children, Parts, Marks, MarkedBy, ByName, Grouped>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfNodes, CollectionOfElements, ElementKinds, KindNames);

using SequenceKinds = ::testing::Types<Owned, Links, Children, Parts>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfNodes, SequenceOfElements, SequenceKinds, KindNames);

using KeyedKinds = ::testing::Types<ByName, Grouped>;
INSTANTIATE_TYPED_TEST_SUITE_P(OfNodes, KeyedElements, KeyedKinds, KindNames);
}  // namespace
}  // namespace testkit
