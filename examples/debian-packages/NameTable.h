/// \file
/// The packages of an index by name while it is read, with the dependencies that wait for them.
#pragma once
#include "Forms.h"

#include <string>
#include <unordered_map>
#include <vector>

namespace debian {

/// Finds packages by name, and ties alternatives to packages that may come later in the file.
///
/// Threads: as the model of its index.
template <ElementForm Form> class NameTable
{
public:
    explicit NameTable(PackageIndex<Form> const& index) : m_index(index) {}

    /// The package of that name, made in the index when it is asked for the first time.
    Package<Form> define(std::string const& name);
    /// Makes the package of that name the target of `alternative`, at once or when it is defined.
    void refer(Alternative<Form> const& alternative, std::string const& name);
    /// Makes a proxy into the model of available packages for each name that was referred to and
    /// never defined, the target of all alternatives that wait for it.
    /// \returns the names, sorted.
    std::vector<std::string> createProxies();

private:
    struct Entry
    {
        Package<Form> package;                   // empty until it is defined
        std::vector<Alternative<Form>> waiting;  // empty from then on
    };

    PackageIndex<Form> m_index;
    std::unordered_map<std::string, Entry> m_entries;
};

}  // namespace debian
