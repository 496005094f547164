/// \file
/// Reads a package index into a model.
///
///     Model const model = Model::create(ModelConstellation());
///     ControlFile file("/var/lib/dpkg/status");
///     auto const loaded = Loader<Generated>(model).load(file);
///     std::cout << loaded.index->getPackages().size() << '\n';
#pragma once
#include "Forms.h"
#include "tarnkiln/kernel/Model.h"

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

namespace debian {
class ControlFile;
template <ElementForm Form> class NameTable;
struct PackageParagraph;

/// What became of an index.
template <ElementForm Form> struct LoadResult
{
    PackageIndex<Form> index;
    std::size_t releases = 0;
    std::size_t groups = 0;
    std::size_t alternatives = 0;
    std::size_t notInstalled = 0;      ///< Paragraphs that the reader passed over.
    std::size_t repeated = 0;          ///< Paragraphs of a release that was there already.
    std::vector<std::string> missing;  ///< Names that became proxies, sorted.
};

/// Makes the elements of an index.
///
/// | Element | Made from | UUID from |
/// |---|---|---|
/// | `PackageIndex` | the file | its kind alone: a model has one |
/// | `Package` | each name in `Package` and `Provides` | the name |
/// | `Release` | a paragraph | name, version, architecture |
/// | `DependencyGroup` | a group of one of the four kinds | its release, kind and number |
/// | `Alternative` | a member of a group | its group and number |
///
/// The kinds are Pre-Depends, Depends, Recommends and Suggests.
/// A dependency names a package, or a proxy into the model `AVAILABLE_URI` if the index has no such
/// name: one proxy for each name. Architectures in dependencies, and versions in `Provides`, are
/// not kept. Of paragraphs with the same name, version and architecture the first one counts.
///
/// Threads: as the model.
template <ElementForm Form> class Loader
{
public:
    /// Called after each paragraph with the number of bytes that were read of the file.
    using Progress = std::function<void(std::size_t)>;

    /// \param model  must not hold a `PackageIndex`.
    explicit Loader(tarn::kiln::Model const& model) : m_model(model) {}

    /// Reads the whole file in one transaction. If it fails the model is as it was.
    ///
    /// \throws ReadError  if the file can not be read or is malformed.
    /// \throws std::runtime_error  if a listener of the model refuses the index.
    LoadResult<Form> load(ControlFile& file, Progress const& progress = {});

private:
    void addPackage(PackageParagraph const& paragraph, NameTable<Form>& names,
                    LoadResult<Form>& result);
    void addGroups(PackageParagraph const& paragraph, Release<Form> const& release,
                   NameTable<Form>& names, LoadResult<Form>& result);

    tarn::kiln::Model m_model;
};

}  // namespace debian
