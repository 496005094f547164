/// \file
/// The keyed collections of elements of a class that is known at run time.
#pragma once
#include "tarnkiln/collections/DataTypeKeys.h"
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/OfRunTimeClass.h"

#include <utility>

namespace tarn::kiln {

/// A keyed collection that a reflective element owns.
///
/// \tparam Keyed  an `ElementMap` or `ElementMultimap` of `ModelElement`.
template <class Keyed>
class TARNKILN_EXPORT ReflectiveKeyedCollection final : public support::OfRunTimeClass<Keyed>
{
    using Base = support::OfRunTimeClass<Keyed>;

public:
    using typename Base::KeyExtractor;

    /// \param owner     null makes a snapshot.
    /// \param opposite  null, if there is no other end; must outlive the collection.
    ReflectiveKeyedCollection(ModelElement::Impl* owner, meta::Class const& elementClass,
                              KeyExtractor extractor, meta::Property::Impl* property,
                              meta::Property::Impl* opposite)
        : Base(elementClass, owner, std::move(extractor), Feature(property), Feature(opposite))
    {}
};

/// One element a key.
template <class K>
using ReflectiveElementMap = ReflectiveKeyedCollection<ElementMap<K, ModelElement>>;
/// Any number of elements a key.
template <class K>
using ReflectiveElementMultimap = ReflectiveKeyedCollection<ElementMultimap<K, ModelElement>>;

#define TARNKILN_DECLARE(K)                                                                        \
    extern template class TARNKILN_EXPORT ReflectiveKeyedCollection<ElementMap<K, ModelElement>>;  \
    extern template class TARNKILN_EXPORT                                                          \
        ReflectiveKeyedCollection<ElementMultimap<K, ModelElement>>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DECLARE)
TARNKILN_DECLARE(ReflectiveDataType)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
