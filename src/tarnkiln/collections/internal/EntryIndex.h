/// \file
/// Where in a long sequence an element is.
#pragma once
#include "tarnkiln/collections/SequenceEntries.h"

#include <cstddef>
#include <vector>

namespace tarn::kiln::internal {

/// A table from elements to the leaves that hold them, for sequences that hold each once.
///
/// Threads: as the collection.
class EntryIndex
{
public:
    using Leaf = support::SequenceEntries::Node;

    /// Room for `count` elements, and some more.
    explicit EntryIndex(std::size_t count);

    /// Null if `element` is not in here.
    Leaf* find(ModelElement::Impl const* element) const;
    /// False if `element` is null or in here already.
    ///
    /// \throws std::bad_alloc  and has changed nothing then.
    bool add(ModelElement::Impl const* element, Leaf* leaf);
    /// Notes that `element` lies in another leaf now.
    void move(ModelElement::Impl const* element, Leaf* leaf) noexcept;
    void remove(ModelElement::Impl const* element) noexcept;

private:
    struct Place
    {
        ModelElement::Impl const* element = nullptr;  ///< Null if the place is free.
        Leaf* leaf = nullptr;
    };

    std::size_t home(ModelElement::Impl const* element) const;
    std::size_t next(std::size_t place) const { return (place + 1) & (m_places.size() - 1); }
    std::size_t findPlace(ModelElement::Impl const* element) const;
    void grow();

    std::vector<Place> m_places;  ///< A power of two, and never full.
    std::size_t m_count = 0;
};
}  // namespace tarn::kiln::internal
