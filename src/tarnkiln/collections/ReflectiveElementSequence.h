/// \file
/// An ordered collection of elements of a class that is known at run time.
#pragma once
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/collections/OfRunTimeClass.h"

namespace tarn::kiln {

/// An `ElementSequence` that a reflective element owns.
class TARNKILN_EXPORT ReflectiveElementSequence final
    : public support::OfRunTimeClass<ElementSequence<ModelElement>>
{
public:
    /// \param owner     null makes a snapshot.
    /// \param opposite  null, if there is no other end; must outlive the sequence.
    ReflectiveElementSequence(ModelElement::Impl* owner, meta::Class const& elementClass,
                              bool unique, meta::Property::Impl* property,
                              meta::Property::Impl* opposite);
    ~ReflectiveElementSequence() override;
};
}  // namespace tarn::kiln
