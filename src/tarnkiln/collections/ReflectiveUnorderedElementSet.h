/// \file
/// An unordered collection of elements of a class that is known at run time.
#pragma once
#include "tarnkiln/collections/OfRunTimeClass.h"
#include "tarnkiln/collections/UnorderedElementSet.h"

namespace tarn::kiln {

/// An `UnorderedElementSet` that a reflective element owns.
class TARNKILN_EXPORT ReflectiveUnorderedElementSet final
    : public support::OfRunTimeClass<UnorderedElementSet<ModelElement>>
{
public:
    /// \param owner     null makes a snapshot.
    /// \param opposite  null, if there is no other end; must outlive the set.
    ReflectiveUnorderedElementSet(ModelElement::Impl* owner, meta::Class const& elementClass,
                                  meta::Property::Impl* property, meta::Property::Impl* opposite);
    ~ReflectiveUnorderedElementSet() override;
};
}  // namespace tarn::kiln
