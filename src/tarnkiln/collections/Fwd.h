/// \file
/// Forward declarations of the collections.
#pragma once

namespace tarn::kiln {
class AbstractOwnedCollection;
class AbstractPrimitiveCollection;
class GenericCollectionInterface;
class GenericMapInterface;
class GenericMultimapInterface;
class GenericPrimitiveAssociativeInterface;
class GenericPrimitiveInterface;
class GenericPrimitiveSequenceInterface;
class GenericSequenceInterface;
class ReferenceCollection;
class SaturatedBloomFilter;
class StringToStringMap;
template <class T> class ElementSequence;
template <class T> class PrimitiveSequence;
template <class T> class PrimitiveSet;
template <class T> class UnorderedElementSet;
template <class K, class T> class ElementMap;
template <class K, class T> class ElementMultimap;
}  // namespace tarn::kiln
