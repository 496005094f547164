/// \file
/// The keys of elements by a qualifying property that is known at run time only.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Property.h"

#include <boost/optional.hpp>

#include <functional>

namespace tarn::kiln {

/// The value of `qualifier` on `element`, read with public access.
///
/// \throws tarnkiln::messages::CannotCastIncompatibleTypes  if there is no value, or one of
///     another type; with the qualified name of the qualifier's type or of the value's.
template <class K> K keyOf(ModelElement::Impl* element, meta::Property const& qualifier);
/// The number of an enumeration literal; fails likewise.
TARNKILN_EXPORT unsigned long enumerationKeyOf(ModelElement::Impl* element,
                                               meta::Property const& qualifier);
/// The UUID of the element that `qualifier` refers to; nil if there is none.
TARNKILN_EXPORT UUID referenceKeyOf(ModelElement::Impl* element, meta::Property const& qualifier);

namespace support {
TARNKILN_EXPORT Value readQualifier(ModelElement::Impl* element, meta::Property const& qualifier);
[[noreturn]] TARNKILN_EXPORT void reportMissingKey(meta::Property const& qualifier);
}  // namespace support

template <class K> K keyOf(ModelElement::Impl* element, meta::Property const& qualifier)
{
    Value const value = support::readQualifier(element, qualifier);
    if (value.getFlags() != ValueFlags::OptionalSingle)
        return value.getValue<K>();
    boost::optional<K> const key = value.getValue<boost::optional<K>>();
    if (!key)
        support::reportMissingKey(qualifier);
    return *key;
}

/// The extractor of a collection keyed by `qualifier`, which it keeps alive; for enumerations and
/// references pass the function that reads them.
template <class K>
std::function<K(ModelElement::Impl*)> makeKeyExtractor(meta::Property const& qualifier,
                                                       K (*read)(ModelElement::Impl*,
                                                                 meta::Property const&) = keyOf<K>)
{
    return [qualifier, read](ModelElement::Impl* element) { return read(element, qualifier); };
}
}  // namespace tarn::kiln
