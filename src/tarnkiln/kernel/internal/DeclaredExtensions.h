/// \file
/// The properties that one model adds to classes, and their defaults.
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Extension.h"

#include <boost/optional.hpp>

#include <unordered_map>
#include <vector>

namespace tarn::kiln::internal {

/// One of them.
struct DeclaredExtensionRecord
{
    meta::Extension extension;
    boost::optional<Value> defaultValue;
    meta::Class extended;  ///< As `extension` says, so long as it belongs to the model.
};

/// What a model remembers of its extensions; the declarations themselves lie in the registry.
///
/// Several may share a name, if their classes have nothing to do with one another.
class DeclaredExtensions
{
public:
    using Record = DeclaredExtensionRecord;

    /// \param modelCounter  of the model that the declarations belong to.
    explicit DeclaredExtensions(unsigned long modelCounter) : m_modelCounter(modelCounter) {}

    /// All that were added under that name, dead ones too.
    std::vector<meta::Extension> named(ustring const& name) const;
    std::vector<meta::Extension> all() const;
    /// The record of exactly that extension; null if there is none. Lives until the next change.
    Record const* find(ustring const& name, meta::Extension const& extension) const;
    /// The record of the live extension of that name that `metaClass`, or the next class above it
    /// that has one, was given; null if there is none. Takes no lock.
    Record const* findFor(meta::Class const& metaClass, ustring const& name) const;
    std::unordered_multimap<ustring, Record> const& records() const { return m_records; }
    bool isEmpty() const { return m_records.empty(); }

    void add(ustring const& name, Record record);
    void remove(ustring const& name, meta::Extension const& extension);
    void clear() { m_records.clear(); }

    /// Whether the registry has no declarations for this model that are missing in here.
    bool isComplete() const { return m_isComplete; }
    void markIncomplete() { m_isComplete = false; }

private:
    /// Whether the extension is live and still what the record says.
    bool isCurrent(Record const& record) const;

    std::unordered_multimap<ustring, Record> m_records;  ///< By the name of the extension.
    unsigned long const m_modelCounter;
    bool m_isComplete = true;
};
}  // namespace tarn::kiln::internal
