#include "tarnkiln/kernel/ModelElement.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelElementBuilder.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tarnkiln/kernel/internal/qualifiedName.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/ClassImpl.h"

namespace tarn::kiln {

ModelElement ModelElement::createProxy(Model const& model, meta::Class const& metaClass,
                                       ProxyId const& id)
{
    std::unique_ptr<Builder> const builder = metaClass->instantiateBuilder(model);
    if (!builder)
        reportException(tarnkiln::messages::NoSuchType(internal::qualifiedName(metaClass)));
    return builder->createProxy(id);
}
} // namespace tarn::kiln
