#include "tarnkiln/collections/QualifierKeys.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace tarn::kiln {

unsigned long enumerationKeyOf(ModelElement::Impl* element, meta::Property const& qualifier)
{
    boost::optional<long> const number = support::readQualifier(element, qualifier).getEnumNumber();
    if (!number)
        support::reportMissingKey(qualifier);
    return static_cast<unsigned long>(*number);
}

UUID referenceKeyOf(ModelElement::Impl* element, meta::Property const& qualifier)
{
    Value const value = support::readQualifier(element, qualifier);
    ModelElement const referred = value.getValue<ModelElement>();
    return referred ? referred->getUuid() : UUID{};
}

namespace support {

Value readQualifier(ModelElement::Impl* element, meta::Property const& qualifier)
{
    return element->getPropertyValue(qualifier, ModelElement::Impl::PUBLIC_ACCESS);
}

void reportMissingKey(meta::Property const& qualifier)
{
    reportException(tarnkiln::messages::CannotCastIncompatibleTypes(
        internal::qualifiedName(qualifier->getType())));
}
}  // namespace support
}  // namespace tarn::kiln
