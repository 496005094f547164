#include "tarnkiln/meta/MetaPackageMeta.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionPrototypeDatatypeSerializer.h"
#include "tarnkiln/meta/TransactionOriginDatatypeSerializer.h"
#include "tarnkiln/meta/internal/buildCatalogueFor.h"
#include "tarnkiln/support/SerializerInstaller.h"

namespace tarn::kiln::meta {

MetaPackageMeta::MetaPackageMeta() : RowPackage(rows::all()) {}

MetaPackageMeta& MetaPackageMeta::getInstance()
{
    static auto* const package = new MetaPackageMeta;
    package->ensureBuilt();
    return *package;
}

void MetaPackageMeta::completed()
{
    // The registry made these two before it could make collections.
    getModelClass()->getOwnedAttributes();
    getModelElementClass()->getOwnedAttributes();

    support::installDatatypeSerializer<ExtensionPrototypeDatatypeSerializer>(
        getDataType(rows::dataTypes::ExtensionPrototype));
    support::installDatatypeSerializer<TransactionOriginDatatypeSerializer>(
        getDataType(rows::dataTypes::TransactionOrigin));
}

Class const& MetaPackageMeta::getModelClass() const
{
    return Model::metaClass();
}

Class const& MetaPackageMeta::getModelElementClass() const
{
    return ModelElement::metaClass();
}
}  // namespace tarn::kiln::meta

void tarn::kiln::internal::buildCatalogueFor(Model::Impl const& model)
{
    if (meta::MetaRegistry::isStarted() &&
        meta::MetaRegistry::getInstance().getModel().getImpl() == &model)
        meta::MetaPackageMeta::getInstance();
}
