/// \file
/// The grammar of package URIs.
#include "tarnkiln/meta/internal/MetaUri.h"

#include "tarnkiln/meta/MetaRegistry.h"
#include "tarnkiln/meta/SchemaBase.h"

namespace tarn::kiln::meta {

// Static objects of clients may use the registry, so this text is there before all of them.
[[gnu::init_priority(101)]] ustring const SchemaBase = u"http://tarnkiln.invalid/tarnkiln/";

std::pair<ustring, ustring> MetaRegistry::parseUri(ustring const& uri)
{
    std::optional<ustring> const family = internal::familyOfUri(uri);
    if (!family)
        return {};
    return {*internal::versionOfUri(uri), *family};
}

bool MetaRegistry::isValidUri(ustring const& uri)
{
    auto const [version, family] = parseUri(uri);
    return !version.empty() && !family.empty();
}

ustring MetaRegistry::composeUri(ustring const& version, ustring const& family)
{
    return SchemaBase + family + u'/' + version;
}
}  // namespace tarn::kiln::meta

namespace tarn::kiln::internal {
namespace {

/// Where the "/" after the family stands; `npos` if `uri` is no package URI.
std::size_t endOfFamily(ustring const& uri)
{
    if (!uri.starts_with(meta::SchemaBase))
        return ustring::npos;
    return uri.find(u'/', meta::SchemaBase.size());
}
}  // namespace

std::optional<ustring> familyOfUri(ustring const& uri)
{
    std::size_t const end = endOfFamily(uri);
    if (end == ustring::npos)
        return std::nullopt;
    return uri.substr(meta::SchemaBase.size(), end - meta::SchemaBase.size());
}

std::optional<ustring> versionOfUri(ustring const& uri)
{
    std::size_t const familyEnd = endOfFamily(uri);
    if (familyEnd == ustring::npos)
        return std::nullopt;
    std::size_t const begin = familyEnd + 1;
    return uri.substr(begin, uri.find(u'/', begin) - begin);
}
}  // namespace tarn::kiln::internal
