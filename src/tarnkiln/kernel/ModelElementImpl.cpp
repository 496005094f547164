#include "tarnkiln/kernel/ModelElementImpl.h"

#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/ExtensionValues.h"
#include "tarnkiln/kernel/internal/StandIn.h"
#include "tarnkiln/kernel/internal/TransactionImpl.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/kernel/internal/uuidText.h"
#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/Operation.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/services/datasource/DataSource.h"

namespace tarn::kiln {

ModelElement::Impl::ReflectionPrivateTag const ModelElement::Impl::PUBLIC_ACCESS;
ModelElement::Impl::ReflectionPrivateTag const ModelElement::Impl::PRIVILEGED_ACCESS;
ModelElement::Impl::ReflectionPrivateTag const ModelElement::Impl::NO_PROXY_RESOLVE;
ModelElement::Impl::ReflectionPrivateTag const ModelElement::Impl::IN_MEMORY_ONLY;

namespace {

[[noreturn]] void reportNoSuchProperty(ModelElement::Impl const& element,
                                       meta::Property const& property)
{
    reportException(
        tarnkiln::messages::NoSuchProperty(property ? property->getName() : ustring(),
                                           internal::qualifiedName(element.getMetaClass())));
}

/// Whether an element that refers to many by `feature` is among many by the opposite too.
bool isListedByBothEnds(Feature const& feature)
{
    return !feature.isSingle() && !feature.isComposite() && !feature.opposite().isComposite();
}

}  // namespace

ModelElement::Impl::Impl(Model const& model, UUID const& id)
    : ElementImpl(id, ElementValidity::Constructing),
      m_model(model.getImpl())
{
    if (!model)
        reportException(tarnkiln::messages::CannotCreateWithoutModel());
}

ModelElement::Impl::~Impl()
{
    bool const isHeld = m_refCount.get() != 0;
    m_refCount.set(REFCOUNT_DELETING);
    if (isHeld)  // by an orchestrator: the constructor of a derived class has failed
        Builder::Orchestrator::constructionFailed(this);
    if (isProxy())
    {
        if (m_isStandInInside)
            std::destroy_at(m_standIn);
        else
            delete m_standIn;
    }
    else if (static_cast<signed char>(m_validity) > 0)
    {
        m_model->remove(this);
    }
    unpinContainer();
    unanchor();
    destroyExtensionValues();
}

Model ModelElement::Impl::getModel() const
{
    return Model(getModelImpl());
}

void ModelElement::Impl::anchor()
{
    if (isProxy() || anchorImpl() || !m_model)
        return;
    support::ModelAnchor* const anchor = m_model->m_anchor.get();
    anchor->addRef();
    if (internal::ExtensionValues* const values = extensionValues())
    {
        values->anchor = anchor;
        return;
    }
    m_anchor = anchor;
    m_aside = Aside::Anchor;
}

void ModelElement::Impl::unanchor()
{
    support::ModelAnchor* const anchor = anchorImpl();
    if (!anchor)
        return;
    if (internal::ExtensionValues* const values = extensionValues())
    {
        values->anchor = nullptr;
    }
    else
    {
        m_aside = Aside::Nothing;
        m_anchor = nullptr;
    }
    anchor->removeRef();
}

/// Null as long as the element is not dead.
support::ModelAnchor* ModelElement::Impl::anchorImpl() const
{
    if (internal::ExtensionValues const* const values = extensionValues())
        return values->anchor;
    return m_aside == Aside::Anchor ? m_anchor : nullptr;
}

Model::Impl* ModelElement::Impl::asideModel() const
{
    support::ModelAnchor const* const anchor = anchorImpl();
    return anchor ? anchor->getModel() : m_model;
}

void ModelElement::Impl::invalidate()
{
    dropEndingExtensions();
    pinContainer();
    anchor();
    ElementImpl::invalidate();
}

void ModelElement::Impl::collectionInvalidated(AbstractOwnedCollection* collection)
{
    if (m_callback)
        m_callback(this, collection);
}

// ---------------------------------------------------------------------------- steps of a class

bool ModelElement::Impl::hasPropertyValue(meta::Property const& property,
                                          ReflectionPrivateTag const&) const
{
    reportNoSuchProperty(*this, property);
}

StoredField ModelElement::Impl::findStoredField(meta::Property const& /*property*/) const
{
    return {};
}

Value ModelElement::Impl::getPropertyValue(meta::Property const& property,
                                           ReflectionPrivateTag const& tag) const
{
    meta::Extension const extension =
        tag == PUBLIC_ACCESS ? meta::Extension() : meta::Extension::cast(property);
    if (!extension || !isExtensionOfClass(extension))
        reportNoSuchProperty(*this, property);
    return getExtension(extension->getName());
}

void ModelElement::Impl::setPropertyValue(meta::Property const& property, Value const& value,
                                          ReflectionPrivateTag const& tag)
{
    meta::Extension const extension =
        tag == PUBLIC_ACCESS ? meta::Extension() : meta::Extension::cast(property);
    if (!extension)
        reportNoSuchProperty(*this, property);
    if (isExtensionOfClass(extension))
        setExtension(extension->getName(), value);
}

boost::optional<Value> ModelElement::Impl::invoke(meta::Operation const& operation,
                                                  std::vector<Value> const& arguments,
                                                  ReflectionPrivateTag const& tag)
{
    // What runs may give the operation another invoker.
    auto const invoker = operation ? operation->getInvoker() : nullptr;
    meta::Class const& metaClass = getMetaClass();
    if (!invoker || !metaClass || !metaClass->isA(operation->getOwningType()) ||
        (!operation->isPublic() && tag == PUBLIC_ACCESS))
    {
        reportException(tarnkiln::messages::NoSuchOperation(
            operation.getElementImpl() ? operation->getName() : ustring(),
            internal::qualifiedName(metaClass)));
    }
    return invoker->invoke(ModelElement(this), arguments);
}

ustring ModelElement::Impl::identifier() const
{
    return ustring();
}

void ModelElement::Impl::inverseAdd(ModelElement const&, meta::Property const& property)
{
    reportNoSuchProperty(*this, property);
}

void ModelElement::Impl::inverseRemove(ModelElement const&, meta::Property const& property)
{
    reportNoSuchProperty(*this, property);
}

bool ModelElement::Impl::inverseContainsProxyTo(ModelElement const&,
                                                meta::Property const& property) const
{
    if (Feature(property).opposite().isComposite())
        return true;
    reportNoSuchProperty(*this, property);
}

void ModelElement::Impl::notifyDestroying()
{
    m_model->elementDestroying(this);
}

void ModelElement::Impl::disassociateIncoming() {}
void ModelElement::Impl::convertReferencesToProxies(bool, boost::optional<ProxyId>&) {}
void ModelElement::Impl::aboutToDestroy() {}
void ModelElement::Impl::didCreate() {}
void ModelElement::Impl::basicDisassociateAll() {}
void ModelElement::Impl::convertToProxy(meta::Property const&, ProxyId const&, ModelElement const&)
{}
void ModelElement::Impl::visitReferences(ReferenceVisitor const&) const {}

void ModelElement::Impl::copyValue(Storage*, unsigned long index) const
{
    reportNoSuchProperty(*this, getPropertyByIndex(index));
}

void ModelElement::Impl::copyStateFromStorage(Storage* storage)
{
    if (storage->isContainerChanged())
        basicSetContainer(storage);
    restoreExtensions(*storage);
}

meta::Property ModelElement::Impl::getPropertyByIndex(unsigned long) const
{
    return meta::Property();
}

void ModelElement::Impl::inverseAddSlot(ModelElement const& element, Slot const& slot)
{
    inverseAdd(element, getPropertyByIndex(slot.index));
}

void ModelElement::Impl::inverseRemoveSlot(ModelElement const& element, Slot const& slot)
{
    inverseRemove(element, getPropertyByIndex(slot.index));
}

bool ModelElement::Impl::inverseContainsProxyToSlot(ModelElement const& element,
                                                    Slot const& slot) const
{
    return inverseContainsProxyTo(element, getPropertyByIndex(slot.index));
}

void ModelElement::Impl::convertToProxySlot(Slot const& slot, ProxyId const& id,
                                            ModelElement const& element)
{
    convertToProxy(getPropertyByIndex(slot.index), id, element);
}

ModelElement::Impl* ModelElement::Impl::basicGetReference(Slot const&) const
{
    return nullptr;
}

// ---------------------------------------------------------------------------- change

void ModelElement::Impl::notifyModifying(unsigned long index)
{
    if (index != NO_INDEX && m_validity == ElementValidity::Valid &&
        !internal::isChangedInSilence(*m_model))
        m_model->elementModifying(this, index);
}

void ModelElement::Impl::notifyModifying(meta::Extension const& extension)
{
    if (Model::Impl* const model = getModelImpl())
        model->elementModifying(this, extension);
}

void ModelElement::Impl::notifyCreated()
{
    m_validity = ElementValidity::Valid;
    m_model->elementCreated(this, /*topLevel=*/true);
    didCreate();
}

// ---------------------------------------------------------------------------- proxies

boost::optional<ProxyId> ModelElement::Impl::getProxyId() const
{
    return isProxy() ? boost::optional<ProxyId>(m_standIn->getId()) : boost::none;
}

ProxyId const* ModelElement::Impl::getProxyIdImpl() const
{
    return isProxy() ? &m_standIn->getId() : nullptr;
}

ProxyId ModelElement::Impl::getPersistentProxyId(bool omitModel) const
{
    if (isProxy())
        return m_standIn->getId();
    Model::Impl const* const model = getModelImpl();
    return model ? model->getPersistentProxyId(this, omitModel)
                 : ProxyId(ElementId::UUID_TYPE, internal::uuidText(getUuid()));
}

void ModelElement::Impl::offerRoom(void* room)
{
    m_standIn = static_cast<internal::StandIn*>(room);
    m_aside = Aside::Room;
}

void ModelElement::Impl::_becomeProxy(ProxyId const& id, ElementValidity validity)
{
    m_isStandInInside = m_aside == Aside::Room;
    m_standIn = m_isStandInInside ? new (m_standIn)
                                        internal::StandIn(*this, id, *m_model->m_proxies)
                                  : new internal::StandIn(*this, id, *m_model->m_proxies);
    m_aside = Aside::StandIn;
    m_validity = validity;
}

void ModelElement::Impl::_convertToProxy(Impl* target, Feature const& feature, ProxyId const& id)
{
    if (!target || target->isProxy())
        return;
    if (feature.slot())
        target->convertToProxySlot(*feature.slot(), id, ModelElement(this));
    else
        target->convertToProxy(feature.property(), id, ModelElement(this));
}

// ---------------------------------------------------------------------------- other ends

void ModelElement::Impl::_callInverseAdd(Impl& other, Feature const& feature)
{
    if (feature.slot())
        other.inverseAddSlot(ModelElement(this), *feature.slot());
    else
        other.inverseAdd(ModelElement(this), feature.property());
}

void ModelElement::Impl::_callInverseRemove(Impl& other, Feature const& feature)
{
    if (feature.slot())
        other.inverseRemoveSlot(ModelElement(this), *feature.slot());
    else
        other.inverseRemove(ModelElement(this), feature.property());
}

void ModelElement::Impl::_inverseAddThis(Impl* other, Feature const& feature, bool force)
{
    if (!other || other->isProxy())
        return;
    Model::Impl const* const model = getModelImpl();
    if (!force && model && model->isParsing() && isListedByBothEnds(feature))
        return;
    _callInverseAdd(*other, feature);
}

void ModelElement::Impl::_inverseRemoveThis(Impl* other, Feature const& feature)
{
    if (other && !other->isProxy())
        _callInverseRemove(*other, feature);
}

bool ModelElement::Impl::_inverseContainsThis(Impl* other, Feature const& feature) const
{
    if (!other || other->isProxy())
        return false;
    ModelElement const self(const_cast<Impl*>(this));
    return feature.slot() ? other->inverseContainsProxyToSlot(self, *feature.slot())
                          : other->inverseContainsProxyTo(self, feature.property());
}

// ---------------------------------------------------------------------------- collections

void ModelElement::Impl::_basicAdd(ReferenceCollection* collection, ModelElement const& element)
{
    collection->basicAdd(element);
}

void ModelElement::Impl::_basicRemove(ReferenceCollection* collection, ModelElement const& element)
{
    collection->basicRemove(element);
}

bool ModelElement::Impl::_basicContainsProxyTo(ReferenceCollection* collection,
                                               ModelElement const& element)
{
    return collection->basicContainsProxyTo(element);
}

void ModelElement::Impl::_basicClear(ReferenceCollection* collection)
{
    collection->basicClear();
}

void ModelElement::Impl::_basicCopyValues(ReferenceCollection* target,
                                          ReferenceCollection const* source)
{
    if (source)
        target->basicCopyValues(*source);
    else
        target->basicClear();
}

void ModelElement::Impl::_loadCollectionContents(ReferenceCollection* collection) const
{
    Model::Impl const* const model = getModelImpl();
    if (model && model->getDataSource())
        model->getDataSource()->loadCollectionContents(collection);
}
}  // namespace tarn::kiln
