/// \file
/// The packages of an index by name while it is read, with the dependencies that wait for them.
#pragma once
#include "model/Alternative.h"
#include "model/Package.h"
#include "model/PackageIndex.h"

#include <string>
#include <unordered_map>
#include <vector>

namespace debian {

/// Finds packages by name, and ties alternatives to packages that may come later in the file.
///
/// Threads: as the model of its index.
class NameTable
{
public:
    explicit NameTable(model::PackageIndex const& index) : m_index(index) {}

    /// The package of that name, made in the index when it is asked for the first time.
    model::Package define(std::string const& name);
    /// Makes the package of that name the target of `alternative`, at once or when it is defined.
    void refer(model::Alternative const& alternative, std::string const& name);
    /// Makes a proxy into the model of available packages for each name that was referred to and
    /// never defined, the target of all alternatives that wait for it.
    /// \returns the names, sorted.
    std::vector<std::string> createProxies();

private:
    struct Entry
    {
        model::Package package;                   // empty until it is defined
        std::vector<model::Alternative> waiting;  // empty from then on
    };

    model::PackageIndex m_index;
    std::unordered_map<std::string, Entry> m_entries;
};

}  // namespace debian
