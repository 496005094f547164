#include "tarnkiln/kernel/ModelElementBuilder.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <utility>

namespace tarn::kiln {

namespace {

/// The last made of those of this thread, which is linked to the one before it.
thread_local constinit ModelElement::Builder::Orchestrator* orchestrators = nullptr;

}  // namespace

ModelElement::Impl::Impl(Builder& builder, UUID const& id) : Impl(builder.getModel(), id)
{
    if (builder.getOrchestrator())
        builder.getOrchestrator()->registerCreatedElement(&builder, this);
}

ModelElement::Builder::Builder(Model const& model, unsigned long bits)
    : m_setProperties(bits),
      m_model(model)
{}

ModelElement::Builder::Builder(unsigned long bits) : m_setProperties(bits) {}

ModelElement::Builder::~Builder()
{
    if (m_orchestrator)
        m_orchestrator->removeBuilder(this);
}

void ModelElement::Builder::setOrAdd(meta::Property const& property, Value const&)
{
    reportException(tarnkiln::messages::NoSuchProperty(property ? property->getName() : ustring(),
                                                       internal::qualifiedName(getMetaClass())));
}

void ModelElement::Builder::setOrAdd(meta::Property const& property, std::unique_ptr<Builder>)
{
    reportException(tarnkiln::messages::NoSuchProperty(property ? property->getName() : ustring(),
                                                       internal::qualifiedName(getMetaClass())));
}

ModelElement ModelElement::Builder::create(UUID const& id)
{
    meta::Class const& metaClass = getMetaClass();
    if (metaClass && metaClass->isAbstract())
        reportException(
            tarnkiln::messages::NoSuchOperation(u"create", internal::qualifiedName(metaClass)));
    return doCreate(/*proxy=*/false, id);
}

ModelElement ModelElement::Builder::createProxy(ProxyId const& id)
{
    ModelElement const proxy = doCreate(/*proxy=*/true, UUID{});
    proxy->_becomeProxy(id, ElementImpl::ElementValidity::BuilderProxy);
    return proxy;
}

// ---------------------------------------------------------------------------- orchestrator

namespace {

/// The model in which `builder` builds.
Model const& modelOf(ModelElement::Builder const& builder)
{
    if (!builder.getModel().getImpl())
        reportException(tarnkiln::messages::CannotCreateWithoutModel());
    return builder.getModel();
}
}  // namespace

ModelElement::Builder::Orchestrator::Orchestrator(Builder* builder)
    : m_model(modelOf(*builder)),
      m_transaction(m_model->beginTransaction(/*revertible=*/true)),
      m_step(m_model.getImpl())
{
    if (m_model->isFrozen())
        reportException(tarnkiln::messages::ModelFrozen());
    addBuilder(builder);
    m_next = std::exchange(orchestrators, this);
}

ModelElement::Builder::Orchestrator::~Orchestrator()
{
    releaseBuilders();
    Orchestrator** link = &orchestrators;
    while (*link != this)
        link = &(*link)->m_next;
    *link = m_next;
}

void ModelElement::Builder::Orchestrator::constructionFailed(ModelElement::Impl const* element)
{
    for (Orchestrator* each = orchestrators; each; each = each->m_next)
    {
        for (auto& [builder, created] : each->m_created)
        {
            if (created.getImpl() == element)
                created = ModelElement();
        }
    }
}

void ModelElement::Builder::Orchestrator::addBuilder(Builder* builder)
{
    if (builder->m_orchestrator)
        return;
    m_created.emplace(builder, ModelElement());
    builder->m_orchestrator = this;
    if (!builder->m_model.getImpl())
        builder->m_model = m_model;
}

void ModelElement::Builder::Orchestrator::removeBuilder(Builder* builder)
{
    m_created.erase(builder);
}

void ModelElement::Builder::Orchestrator::registerCreatedElement(Builder* builder,
                                                                 ModelElement::Impl* element)
{
    m_created[builder] = ModelElement(element);
}

void ModelElement::Builder::Orchestrator::forgetCreatedElement(Builder* builder)
{
    m_created[builder] = ModelElement();
}

ModelElement ModelElement::Builder::Orchestrator::getCreatedElement(Builder* builder) const
{
    auto const found = m_created.find(builder);
    return found == m_created.end() ? ModelElement() : found->second;
}

void ModelElement::Builder::Orchestrator::commit()
{
    m_step.close();
    m_transaction.commit();
    releaseBuilders();
}

void ModelElement::Builder::Orchestrator::releaseBuilders()
{
    for (auto const& entry : m_created)
        entry.first->m_orchestrator = nullptr;
    m_created.clear();
}
}  // namespace tarn::kiln
