#include "tarnkiln/collections/ReflectiveUnorderedElementSet.h"

namespace tarn::kiln {

ReflectiveUnorderedElementSet::ReflectiveUnorderedElementSet(ModelElement::Impl* owner,
                                                             meta::Class const& elementClass,
                                                             meta::Property::Impl* property,
                                                             meta::Property::Impl* opposite)
    : OfRunTimeClass(elementClass, owner, Feature(property), Feature(opposite))
{}

ReflectiveUnorderedElementSet::~ReflectiveUnorderedElementSet() = default;
}  // namespace tarn::kiln
