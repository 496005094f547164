#include "tarnkiln/kernel/ModelElement.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/ReflectiveModelElementImpl.h"

namespace tarn::kiln {

ModelElement ModelElement::createProxy(Model const& model, meta::Class const& metaClass,
                                       ProxyId const& id)
{
    if (std::unique_ptr<Builder> const builder = metaClass->instantiateBuilder(model))
        return builder->createProxy(id);
    {
        meta::MetaRegistry::LockedModel const locked(meta::MetaRegistry::getInstance());
        bool const isRegistered = metaClass->getModelImpl() == locked.getModel().getImpl();
        if (isRegistered || metaClass->isAbstract())
            reportException(tarnkiln::messages::NoSuchType(internal::qualifiedName(metaClass)));
    }
    ModelElement const proxy(ReflectiveModelElementImpl::createForProxy(model, metaClass));
    proxy->_becomeProxy(id, ElementImpl::ElementValidity::Constructing);
    return proxy;
}

ModelElement ModelElement::createReflective(Model const& model, meta::Class const& metaClass,
                                            UUID const& id)
{
    ModelElement const element(ReflectiveModelElementImpl::create(model, metaClass, id));
    element->notifyCreated();
    return element;
}
}  // namespace tarn::kiln
