#include "tarnkiln/collections/QualifierKeys.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {

unsigned long enumerationKeyOf(ModelElement::Impl* element, meta::Property const& qualifier)
{
    // A literal's value travels as unsigned but reads as signed.
    return static_cast<unsigned long>(keyOf<long>(element, qualifier));
}

UUID referenceKeyOf(ModelElement::Impl* element, meta::Property const& qualifier)
{
    Value const value = internal::readQualifier(element, qualifier);
    ModelElement const referred = value.getValue<ModelElement>();
    return referred ? referred->getUuid() : UUID{};
}

namespace internal {

Value readQualifier(ModelElement::Impl* element, meta::Property const& qualifier)
{
    return element->getPropertyValue(qualifier, ModelElement::Impl::PUBLIC_ACCESS);
}

void reportMissingKey(meta::Property const& qualifier)
{
    reportException(
        tarnkiln::messages::CannotCastIncompatibleTypes(qualifiedName(qualifier->getType())));
}
}  // namespace internal
}  // namespace tarn::kiln
