#include "tarnkiln/services/ElementIdResolver.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/internal/uuidText.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/services/datasource/DataSource.h"
#include "tarnkiln/services/internal/DiscoverServices.h"

#include <boost/lexical_cast/try_lexical_convert.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln::services {
namespace {

/// The element of that UUID and of exactly that class, in memory or from the data source.
ModelElement findByUuid(Model const& model, meta::Class const& metaClass, ElementId const& id,
                        UUID const& uuid)
{
    ModelElement element = model->findElement(uuid, FindElementBehavior::InMemory);
    if (!element && model->getDataSource())
        element = model->getDataSource()->lookupElement(metaClass, id);
    bool const isAnswer = element && element->getMetaClass() == metaClass;
    return isAnswer ? element : ModelElement();
}

bool parseUuid(ustring const& text, UUID& uuid)
{
    return internal::parseUuidText(text, uuid) ||
           boost::conversion::try_lexical_convert(sill::i18n::to_string(text), uuid);
}

ModelElement askServices(Model const& model, meta::Class const& metaClass, ElementId const& id)
{
    string const filter =
        "(bundle.tarnkiln.elementIdResolver=" + internal::escapeFilterValue(id.getType()) + ')';
    for (auto const& found : internal::discoverServices<ElementIdResolver>(filter))
    {
        if (ModelElement const element = found.service->resolveElement(model, metaClass, id))
            return element;
    }
    return {};
}
}  // namespace

ElementIdResolver::~ElementIdResolver() = default;

ModelElement ElementIdResolver::doFindElement(Model const& model, meta::Class const& metaClass,
                                              ElementId const& id)
{
    if (id.getType() == ElementId::UUID_TYPE)
    {
        UUID uuid;
        if (!parseUuid(id.getId(), uuid))
            return {};
        if (ModelElement const element = findByUuid(model, metaClass, id, uuid))
            return element;
    }
    return askServices(model, metaClass, id);
}
}  // namespace tarn::kiln::services
