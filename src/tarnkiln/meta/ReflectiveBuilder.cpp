#include "tarnkiln/meta/ReflectiveBuilder.h"

#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"

#include <algorithm>
#include <utility>

namespace tarn::kiln {
namespace {

auto const& ACCESS = ModelElement::Impl::PRIVILEGED_ACCESS;

bool isSingle(meta::Property const& property)
{
    return property->getUpper() == 1;
}

/// One more than the highest slot of an element of `metaClass`.
unsigned long slotsOf(meta::Class const& metaClass)
{
    int highest = 0;
    for (meta::Class type = metaClass; type; type = type->getSuperclass())
        for (auto const& [name, property] : type->getOwnedAttributes())
            highest = std::max(highest, property->getPropertyIndex());
    return static_cast<unsigned long>(highest) + 1;
}

void addTo(ModelElement const& element, meta::Property const& property, Value const& added)
{
    Value const collection = element->getPropertyValue(property, ACCESS);
    if (internal::classImpl(property->getType()))
        collection.getValue<ReferenceCollection&>().getGenericInterface()->genericAdd(
            added.getValue<ModelElement>());
    else
        collection.getValue<AbstractPrimitiveCollection&>().genericAdd(added);
}

}  // namespace

ReflectiveBuilder::ReflectiveBuilder(Model const& model, meta::Class const& metaClass)
    : Builder(model, slotsOf(metaClass)),
      m_metaClass(metaClass)
{}

ReflectiveBuilder::ReflectiveBuilder(meta::Class const& metaClass)
    : Builder(slotsOf(metaClass)),
      m_metaClass(metaClass)
{}

bool ReflectiveBuilder::isStored(meta::Property const& property) const
{
    return property && m_metaClass && m_metaClass->isATypeOf(property) && !property->isDerived();
}

void ReflectiveBuilder::setOrAdd(meta::Property const& property, Value const& value)
{
    if (!isStored(property))
        return Builder::setOrAdd(property, value);
    if (isSingle(property))
        value.checkCompatibleWithProperty(property);
    give({property, value, nullptr});
}

void ReflectiveBuilder::setOrAdd(meta::Property const& property, std::unique_ptr<Builder> value)
{
    bool const suits = isStored(property) && property->isComposite() && value &&
                       value->getMetaClass()->isA(property->getType());
    if (!suits)
        return Builder::setOrAdd(property, std::move(value));
    give({property, Value::createElementValue(property, ModelElement()), std::move(value)});
}

void ReflectiveBuilder::give(Given given)
{
    m_setProperties.set(static_cast<unsigned long>(given.property->getPropertyIndex()));
    auto const place =
        isSingle(given.property)
            ? std::find_if(m_given.begin(), m_given.end(),
                           [&](Given const& earlier) { return earlier.property == given.property; })
            : m_given.end();
    if (place == m_given.end())
        m_given.push_back(std::move(given));
    else
        *place = std::move(given);
}

ModelElement ReflectiveBuilder::doCreate(bool proxy, UUID const& id)
{
    if (proxy)
    {
        checkConcrete();
        return ModelElement(ReflectiveModelElementImpl::createForProxy(getModel(), m_metaClass));
    }
    if (getOrchestrator())
        return build(id);
    Orchestrator orchestrator(this);
    ModelElement const made = build(id);
    orchestrator.commit();
    return made;
}

void ReflectiveBuilder::checkConcrete() const
{
    if (m_metaClass && m_metaClass->isAbstract())
        reportException(
            tarnkiln::messages::NoSuchOperation(u"create", internal::qualifiedName(m_metaClass)));
}

ModelElement ReflectiveBuilder::construct(UUID const& id) const
{
    checkConcrete();
    return ModelElement(ReflectiveModelElementImpl::create(
        getModel(), m_metaClass, id.is_nil() ? ElementImpl::generateNewUuid() : id));
}

ModelElement ReflectiveBuilder::build(UUID const& id)
{
    if (ModelElement const present = getOrchestrator()->getCreatedElement(this))
        return present;
    ModelElement const made = construct(id);
    getOrchestrator()->registerCreatedElement(this, made.getImpl());
    made->notifyCreated();
    for (Given const& given : m_given)
    {
        if (isSingle(given.property))
            made->setPropertyValue(given.property, valueOf(given), ACCESS);
        else
            addTo(made, given.property, valueOf(given));
    }
    return made;
}

/// Builds what there is a builder for, in the creation that this builder takes part in.
Value ReflectiveBuilder::valueOf(Given const& given)
{
    if (!given.nested)
        return given.value;
    getOrchestrator()->addBuilder(given.nested.get());
    if (given.nested->getModel() != getModel())
        reportException(tarnkiln::messages::CannotChangeModel());
    return Value::createElementValue(given.property, given.nested->create());
}
}  // namespace tarn::kiln
