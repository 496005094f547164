/// \file
/// The properties that one model adds to classes, and their defaults.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Extension.h"

#include <boost/optional.hpp>

#include <unordered_map>
#include <vector>

namespace tarn::kiln::internal {

/// What a model remembers of its extensions; the declarations themselves lie in the registry.
///
/// Several may share a name, if their classes have nothing to do with one another.
class DeclaredExtensions
{
public:
    struct Record
    {
        meta::Extension extension;
        boost::optional<Value> defaultValue;
    };

    /// All that were added under that name, dead ones too.
    std::vector<meta::Extension> named(ustring const& name) const;
    std::vector<meta::Extension> all() const;
    /// The record of exactly that extension; null if there is none. Lives until the next change.
    Record const* find(ustring const& name, meta::Extension const& extension) const;
    bool isEmpty() const { return m_records.empty(); }

    void add(ustring const& name, Record record);
    void remove(ustring const& name, meta::Extension const& extension);
    void clear() { m_records.clear(); }

private:
    std::unordered_multimap<ustring, Record> m_records;  ///< By the name of the extension.
};
}  // namespace tarn::kiln::internal
