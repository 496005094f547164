#include "Loader.h"

#include "NameTable.h"
#include "reader/ControlFile.h"
#include "reader/NameBasedUuid.h"
#include "reader/PackageReader.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"

#include "sill/i18n/StringConversion.h"

#include <array>
#include <stdexcept>

namespace debian {

using namespace tarn::kiln;
using sill::i18n::to_ustring;

namespace {

/// The kinds that say what a package needs or likes to have. The others exclude packages.
constexpr std::array LOADED_KINDS = {DependencyKind::PreDepends, DependencyKind::Depends,
                                     DependencyKind::Recommends, DependencyKind::Suggests};

/// The UUID of something inside the release; `kind` tells what and which.
UUID uuidInRelease(std::string const& kind, PackageParagraph const& paragraph)
{
    return nameBasedUuid(kind, paragraph.package, paragraph.version.text(), paragraph.architecture);
}

template <ElementForm Form>
Release<Form> makeRelease(Model const& model, PackageParagraph const& paragraph,
                          ustring const& label)
{
    auto const release = Release<Form>::create(model, uuidInRelease("release", paragraph));
    release->setLabel(label);
    release->setVersion(to_ustring(paragraph.version.text()));
    release->setArchitecture(to_ustring(paragraph.architecture));
    release->setSection(to_ustring(paragraph.section));
    release->setMaintainer(to_ustring(paragraph.maintainer));
    release->setSummary(to_ustring(paragraph.description));
    if (paragraph.installedSize)
        release->setInstalledSize(static_cast<long>(*paragraph.installedSize));
    release->setIsEssential(paragraph.essential);
    return release;
}

template <ElementForm Form>
Alternative<Form> makeAlternative(Model const& model, UUID const& id,
                                  PackageRelation const& relation)
{
    auto const alternative = Alternative<Form>::create(model, id);
    if (relation.bound)
    {
        alternative->setRelation(to_ustring(toString(relation.bound->relation)));
        alternative->setBound(to_ustring(relation.bound->version.text()));
    }
    return alternative;
}

}  // namespace

template <ElementForm Form>
LoadResult<Form> Loader<Form>::load(ControlFile& file, Progress const& progress)
{
    Transaction const transaction = m_model->beginTransaction(/*revertible=*/true);
    LoadResult<Form> result;
    result.index = PackageIndex<Form>::create(m_model, nameBasedUuid("index", "", "", ""));
    NameTable<Form> names(result.index);
    PackageReader reader(file);
    while (auto const paragraph = reader.next())
    {
        addPackage(*paragraph, names, result);
        if (progress)
            progress(file.bytesRead());
    }
    result.notInstalled = reader.skippedCount();
    result.missing = names.createProxies();
    if (transaction.commit() != TransactionResult::Committed)
        throw std::runtime_error(file.name() + ": a listener of the model refused the index");
    return result;
}

template <ElementForm Form>
void Loader<Form>::addPackage(PackageParagraph const& paragraph, NameTable<Form>& names,
                              LoadResult<Form>& result)
{
    Package<Form> const package = names.define(paragraph.package);
    ustring const label = to_ustring(paragraph.version.text() + ' ' + paragraph.architecture);
    if (package->getReleases().count(label) != 0)
    {
        ++result.repeated;
        return;
    }
    Release<Form> const release = makeRelease<Form>(m_model, paragraph, label);
    release->setPackage(package);
    ++result.releases;
    addGroups(paragraph, release, names, result);
    for (PackageRelation const& provided : paragraph.provides)
        release->getProvides().push_back(names.define(provided.package));
}

template <ElementForm Form>
void Loader<Form>::addGroups(PackageParagraph const& paragraph, Release<Form> const& release,
                             NameTable<Form>& names, LoadResult<Form>& result)
{
    for (DependencyKind const kind : LOADED_KINDS)
    {
        std::size_t groupNumber = 0;
        for (RelationGroup const& relations : paragraph.dependenciesOf(kind))
        {
            std::string const place =
                std::string(fieldName(kind)) + '/' + std::to_string(++groupNumber);
            auto const group =
                DependencyGroup<Form>::create(m_model, uuidInRelease(place, paragraph));
            group->setKind(to_ustring(fieldName(kind)));
            group->setRelease(release);
            ++result.groups;

            std::size_t number = 0;
            for (PackageRelation const& relation : relations)
            {
                UUID const id = uuidInRelease(place + '/' + std::to_string(++number), paragraph);
                auto const alternative = makeAlternative<Form>(m_model, id, relation);
                alternative->setGroup(group);
                names.refer(alternative, relation.package);
                ++result.alternatives;
            }
        }
    }
}

#define DEBIAN_INSTANTIATE(Form) template class Loader<Form>;
DEBIAN_FOR_EACH_FORM(DEBIAN_INSTANTIATE)

}  // namespace debian
