#include "tarnkiln/collections/ReflectiveElementSequence.h"

namespace tarn::kiln {

ReflectiveElementSequence::ReflectiveElementSequence(ModelElement::Impl* owner,
                                                     meta::Class const& elementClass, bool unique,
                                                     meta::Property::Impl* property,
                                                     meta::Property::Impl* opposite)
    : OfRunTimeClass(elementClass, owner, unique, Feature(property), Feature(opposite))
{}

ReflectiveElementSequence::~ReflectiveElementSequence() = default;
}  // namespace tarn::kiln
