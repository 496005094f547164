/// \file
/// Forward declarations of the collections.
#pragma once

namespace tarn::kiln {
class AbstractOwnedCollection;
class AbstractPrimitiveCollection;
class GenericCollectionInterface;
class GenericPrimitiveInterface;
class ReferenceCollection;
class SaturatedBloomFilter;
class StringToStringMap;
} // namespace tarn::kiln
