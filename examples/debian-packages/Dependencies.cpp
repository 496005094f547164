#include "Dependencies.h"

#include "reader/Version.h"

#include "sill/i18n/StringConversion.h"

#include <stdexcept>

namespace debian {

using sill::i18n::to_string;
using tarn::kiln::ustring;

namespace {

VersionRelation relationOf(ustring const& text)
{
    if (text == u"<<")
        return VersionRelation::StrictlyEarlier;
    if (text == u"<=")
        return VersionRelation::EarlierOrEqual;
    if (text == u"=")
        return VersionRelation::Equal;
    if (text == u">=")
        return VersionRelation::LaterOrEqual;
    if (text == u">>")
        return VersionRelation::StrictlyLater;
    throw std::invalid_argument("no relation of versions: " + to_string(text));
}

}  // namespace

template <ElementForm Form>
bool fits(Release<Form> const& release, Alternative<Form> const& alternative)
{
    if (alternative->getRelation().empty())
        return true;
    Version const version(to_string(release->getVersion()));
    Version const bound(to_string(alternative->getBound()));
    return version.satisfies(relationOf(alternative->getRelation()), bound);
}

template <ElementForm Form>
std::vector<DependencyGroup<Form>> strictGroupsOf(Release<Form> const& release)
{
    std::vector<DependencyGroup<Form>> result;
    forEachGroup<Form>(release, [&](DependencyGroup<Form> const& group) {
        if (isStrict<Form>(group))
            result.push_back(group);
    });
    return result;
}

template <ElementForm Form>
std::vector<Release<Form>> satisfiersOf(DependencyGroup<Form> const& group)
{
    std::vector<Release<Form>> result;
    forEachAlternative<Form>(group, [&](Alternative<Form> const& alternative) {
        Package<Form> const target = installedTarget<Form>(alternative);
        if (!target)
            return;
        forEachRelease<Form>(target, [&](Release<Form> const& release) {
            if (fits<Form>(release, alternative))
                result.push_back(release);
        });
        forEachProvider<Form>(target,
                              [&](Release<Form> const& provider) { result.push_back(provider); });
    });
    return result;
}

#define DEBIAN_INSTANTIATE(Form)                                                                   \
    template bool fits<Form>(Release<Form> const&, Alternative<Form> const&);                      \
    template std::vector<DependencyGroup<Form>> strictGroupsOf<Form>(Release<Form> const&);        \
    template std::vector<Release<Form>> satisfiersOf<Form>(DependencyGroup<Form> const&);
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
