#include "Dependencies.h"

#include "model/AlternativeImpl.h"
#include "model/DependencyGroupImpl.h"
#include "model/PackageImpl.h"
#include "model/PackageIndexImpl.h"
#include "model/ReleaseImpl.h"
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

bool fits(model::Release const& release, model::Alternative const& alternative)
{
    if (alternative->getRelation().empty())
        return true;
    Version const version(to_string(release->getVersion()));
    Version const bound(to_string(alternative->getBound()));
    return version.satisfies(relationOf(alternative->getRelation()), bound);
}

}  // namespace

bool isStrict(model::DependencyGroup const& group)
{
    return group->getKind() == u"Depends" || group->getKind() == u"Pre-Depends";
}

bool isSuggestion(model::DependencyGroup const& group)
{
    return group->getKind() == u"Suggests";
}

model::Package installedTarget(model::Alternative const& alternative)
{
    model::Package const target(alternative->getTargetImpl());
    bool const isHere =
        target && !target->isProxy() && target->getModelImpl() == alternative->getModelImpl();
    return isHere ? target : model::Package();
}

std::vector<model::Release> satisfiersOf(model::DependencyGroup const& group)
{
    std::vector<model::Release> result;
    forEachAlternative(group, [&](model::Alternative const& alternative) {
        model::Package const target = installedTarget(alternative);
        if (!target)
            return;
        forEachRelease(target, [&](model::Release const& release) {
            if (fits(release, alternative))
                result.push_back(release);
        });
        if (target->hasProviders())
            result.insert(result.end(), target->getProviders().begin(),
                          target->getProviders().end());
    });
    return result;
}

void forEachRelease(model::Package const& package,
                    std::function<void(model::Release const&)> const& visit)
{
    if (!package->hasReleases())
        return;
    for (auto const& [label, release] : package->getReleases())
        visit(release);
}

void forEachRelease(model::PackageIndex const& index,
                    std::function<void(model::Release const&)> const& visit)
{
    for (auto const& [name, package] : index->getPackages())
        forEachRelease(package, visit);
}

void forEachGroup(model::Release const& release,
                  std::function<void(model::DependencyGroup const&)> const& visit)
{
    if (!release->hasGroups())
        return;
    for (model::DependencyGroup const& group : release->getGroups())
        visit(group);
}

void forEachAlternative(model::DependencyGroup const& group,
                        std::function<void(model::Alternative const&)> const& visit)
{
    if (!group->hasAlternatives())
        return;
    for (model::Alternative const& alternative : group->getAlternatives())
        visit(alternative);
}

bool isEssential(model::Package const& package)
{
    bool essential = false;
    forEachRelease(package,
                   [&](model::Release const& release) { essential |= release->isEssential(); });
    return essential;
}

}  // namespace debian
