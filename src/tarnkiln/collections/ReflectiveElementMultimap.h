/// \file
/// A keyed collection of elements of a class that is known at run time, any number of elements a
/// key.
#pragma once
#include "tarnkiln/collections/DataTypeKeys.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/OfRunTimeClass.h"

#include <utility>

namespace tarn::kiln {

/// An `ElementMultimap` that a reflective element owns.
template <class K>
class TARNKILN_EXPORT ReflectiveElementMultimap final
    : public support::OfRunTimeClass<ElementMultimap<K, ModelElement>>
{
    using Base = support::OfRunTimeClass<ElementMultimap<K, ModelElement>>;

public:
    using typename Base::KeyExtractor;

    /// \param owner     null makes a snapshot.
    /// \param opposite  null, if there is no other end; must outlive the multimap.
    ReflectiveElementMultimap(ModelElement::Impl* owner, meta::Class const& elementClass,
                              KeyExtractor extractor, meta::Property::Impl* property,
                              meta::Property::Impl* opposite)
        : Base(elementClass, owner, std::move(extractor), Feature(property), Feature(opposite))
    {}
};

#define TARNKILN_DECLARE(K) extern template class TARNKILN_EXPORT ReflectiveElementMultimap<K>;
TARNKILN_FOR_EACH_KEY_TYPE(TARNKILN_DECLARE)
TARNKILN_DECLARE(ReflectiveDataType)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln
