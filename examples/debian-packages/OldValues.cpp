#include "OldValues.h"

#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

namespace debian {

using namespace tarn::kiln;

std::vector<meta::Property> propertiesOf(meta::Class const& metaClass)
{
    std::vector<meta::Property> result;
    for (meta::Class type = metaClass; type; type = type->getSuperclass())
    {
        for (auto const& [name, property] : type->getOwnedAttributes())
            result.push_back(property);
    }
    return result;
}

meta::Property propertyOf(ModelElement const& element, ustring const& name)
{
    return element->getMetaClass()->getOwnedAttributes().find(name);
}

bool isReference(meta::Property const& property)
{
    return meta::Class::cast(property->getType()).getImpl() != nullptr;
}

bool isMany(meta::Property const& property)
{
    return property->getUpper() > 1;
}

bool isContainer(meta::Property const& property)
{
    meta::Property const opposite = property->getOpposite();
    return opposite && opposite->isComposite();
}

std::vector<ModelElement> oldMembers(ReportData const& report, ModelElement const& element,
                                     meta::Property const& property)
{
    try
    {
        Value const old = report.getOldValue(element, property);
        return old.getValue<ReferenceCollection&>().getAllValuesAndProxies();
    }
    catch (tarnkiln::messages::CannotCastIncompatibleTypes const&)
    {
        // A collection that was empty, or never made, has no old value to give.
        return {};
    }
}

ModelElement oldTarget(ReportData const& report, ModelElement const& element,
                       meta::Property const& property)
{
    return report.getOldValue(element, property).getValue<ModelElement>();
}

}  // namespace debian
