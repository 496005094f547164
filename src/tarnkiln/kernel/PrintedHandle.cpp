// How handles and identifiers are shown to people.
#include "tarnkiln/kernel/ElementHandle.h"
#include "tarnkiln/kernel/ModelId.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/streamText.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/NamedElementImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln {
namespace {

/// The property `name` of an element that is no metamodel element; empty if its class has none
/// that could be read without side effects.
meta::Property nameProperty(ModelElement::Impl const& element)
{
    if (!element.isLive() || !element.getMetaClass())
        return meta::Property();
    meta::Property const property = element.getMetaClass()->getPropertyByName(u"name");
    bool const isText = property && !property->isDerived() && property->getUpper() == 1 &&
                        property->getType() == meta::StandardTypes::stringMeta;
    return isText ? property : meta::Property();
}

boost::optional<ustring> nameOf(ElementImpl const& impl)
{
    if (auto const* const model = dynamic_cast<Model::Impl const*>(&impl))
        return boost::make_optional(!model->getModelURI().empty(), model->getModelURI());
    if (auto const* const named = dynamic_cast<meta::NamedElement::Impl const*>(&impl))
        return named->getName();
    auto const* const element = dynamic_cast<ModelElement::Impl const*>(&impl);
    meta::Property const property = element ? nameProperty(*element) : meta::Property();
    if (!property)
        return boost::none;
    return element->getPropertyValue(property, ModelElement::Impl::IN_MEMORY_ONLY)
        .getValue<boost::optional<ustring>>();
}

void streamState(std::ostream& out, ElementImpl const& impl)
{
    auto const* const element = dynamic_cast<ModelElement::Impl const*>(&impl);
    if (!impl.isLive())
        out << " (destroyed)";
    else if (element && element->isProxy())
        out << " (stands in for " << *element->getProxyIdImpl() << ')';
}
}  // namespace

std::ostream& operator<<(std::ostream& out, ElementHandle const& handle)
{
    ElementImpl const* const impl = handle.getElementImpl();
    if (!impl)
        return out << "empty handle";
    meta::Class const& metaClass = impl->getMetaClass();
    // The earliest elements, and those of a class that is gone.
    out << (metaClass.getImpl() ? toUtf8(metaClass->getName()) : "element");
    if (boost::optional<ustring> const name = nameOf(*impl))
    {
        out << ' ';
        internal::streamQuoted(out, *name);
    }
    out << ' ' << impl->getUuid();
    streamState(out, *impl);
    return out;
}

std::ostream& operator<<(std::ostream& out, ElementId const& id)
{
    return out << toUtf8(id.getType()) << ':' << toUtf8(id.getId());
}

std::ostream& operator<<(std::ostream& out, ProxyId const& id)
{
    out << static_cast<ElementId const&>(id);
    if (id.getModelId() && !id.getModelId()->empty())
        out << " in " << toUtf8(*id.getModelId());
    return out;
}

std::ostream& operator<<(std::ostream& out, ModelId const& id)
{
    if (!id.prefix.empty())
        out << toUtf8(id.prefix) << '@';
    return out << toUtf8(id.scheme) << ':' << toUtf8(id.path);
}

std::ostream& operator<<(std::ostream& out, TransactionResult result)
{
    switch (result)
    {
    case TransactionResult::NotCompleted:
        return out << "NotCompleted";
    case TransactionResult::Committed:
        return out << "Committed";
    case TransactionResult::RolledBack:
        return out << "RolledBack";
    case TransactionResult::NotRevertible:
        return out << "NotRevertible";
    }
    return out << static_cast<int>(result);
}
}  // namespace tarn::kiln
