/// \file
/// A fingerprint of all that a model holds, to tell whether two states of it are equal.
#pragma once
#include "tarnkiln/kernel/Model.h"

#include <cstddef>
#include <string>
#include <utility>
#include <vector>

namespace debian {

/// A digest of each element of a model: its class, its container and the property that holds it,
/// all plain values, and the targets of all references in their order.
///
/// Classes and properties count by their own names, so that models with different metamodels are
/// equal if all names and values are.
///
/// Elements are told apart by UUID, not by object, and so are targets; a proxy is the same as the
/// element that it stands for, since resolving is no change; a destroyed target is not. Taking a
/// snapshot changes nothing and resolves nothing. It knows no class of elements.
///
/// Digests are of 122 bits (SHA-1, cut to a UUID): different elements have different ones as far
/// as anybody can tell.
///
/// Threads: made on the thread of the model, then a plain value.
class ModelSnapshot
{
public:
    explicit ModelSnapshot(tarn::kiln::Model const& model);

    bool operator==(ModelSnapshot const& other) const = default;
    std::size_t elementCount() const { return m_digests.size(); }
    /// The same for equal snapshots, in this and all other processes: a digest of all digests.
    std::string fingerprint() const;

    /// A line for each element that is in one of the two only or differs, up to `maxLines`.
    std::vector<std::string> differences(ModelSnapshot const& later, std::size_t maxLines) const;

private:
    using Digest = tarn::kiln::UUID;

    std::vector<std::pair<tarn::kiln::UUID, Digest>> m_digests;  // ascending
};

}  // namespace debian
