#include "tarnkiln/services/ElementIdResolver.h"

#include "sill/i18n/StringConversion.h"
#include "tarnkiln/kernel/ElementId.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/services/datasource/DataSource.h"
#include "tarnkiln/services/internal/DiscoverServices.h"

#include <boost/lexical_cast/try_lexical_convert.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <cstddef>
#include <cstdint>
#include <string_view>

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

int valueOf(char16_t digit)
{
    if (digit >= u'0' && digit <= u'9')
        return digit - u'0';
    char16_t const lower = static_cast<char16_t>(digit | 0x20);
    return lower >= u'a' && lower <= u'f' ? lower - u'a' + 10 : -1;
}

/// Of the usual form, 8-4-4-4-12 digits. False for any other text.
bool parseUsualForm(std::u16string_view text, UUID& uuid)
{
    constexpr std::size_t LENGTH = 36;
    if (text.size() != LENGTH)
        return false;
    std::size_t at = 0;
    for (std::uint8_t& byte : uuid.data)
    {
        bool const isGroup = at == 8 || at == 13 || at == 18 || at == 23;
        if (isGroup && text[at++] != u'-')
            return false;
        int const high = valueOf(text[at++]);
        int const low = valueOf(text[at++]);
        if (high < 0 || low < 0)
            return false;
        byte = static_cast<std::uint8_t>(high << 4 | low);
    }
    return true;
}

bool parseUuid(ustring const& text, UUID& uuid)
{
    return parseUsualForm(text, uuid) ||
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
