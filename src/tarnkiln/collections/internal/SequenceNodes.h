/// \file
/// The blocks of which `SequenceEntries` are made.
#pragma once
#include "tarnkiln/Assert.h"
#include "tarnkiln/collections/SequenceEntries.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>

namespace tarn::kiln::internal {

constexpr unsigned FULL_LEAF = 31;  ///< With its parent behind, a leaf fills what malloc gives.
constexpr unsigned FULL_INNER = 32;
constexpr unsigned SMALL_LEAF = 12;  ///< A smaller one looks for a neighbour to join.
constexpr unsigned MAX_HEIGHT = 16;

/// Has the counts of elements at hand when they are about to change.
inline void prefetchElements(ModelElement const* first, std::size_t count)
{
    for (ModelElement const* each = first; each != first + count; ++each)
        __builtin_prefetch(each->getElementImpl(), /*rw=*/1);
}
}  // namespace tarn::kiln::internal

namespace tarn::kiln::support {

static_assert(sizeof(ModelElement) == sizeof(void*), "entries are moved as bytes");

struct SequenceEntries::Inner : Node
{
    explicit Inner(unsigned atLevel) : Node(atLevel, internal::FULL_INNER) {}

    /// The child that has the place `index` of `total`, which becomes the place in the child. That
    /// between two children is the first one of the second.
    unsigned childAt(std::size_t& index, std::size_t total) const
    {
        if (index < total / 2)
        {
            unsigned child = 0;
            while (index >= sizes[child])
                index -= sizes[child++];
            return child;
        }
        std::size_t behind = total - index;
        unsigned child = count - 1u;
        while (behind > sizes[child])
            behind -= sizes[child--];
        index = sizes[child] - behind;
        return child;
    }
    void insertChild(unsigned at, Node* node, std::size_t size)
    {
        std::copy_backward(children + at, children + count, children + count + 1);
        std::copy_backward(sizes + at, sizes + count, sizes + count + 1);
        children[at] = node;
        sizes[at] = static_cast<std::uint32_t>(size);
        ++count;
    }
    void removeChild(unsigned at)
    {
        std::copy(children + at + 1, children + count, children + at);
        std::copy(sizes + at + 1, sizes + count, sizes + at);
        --count;
    }
    /// Moves children to the end of another one.
    void moveChildren(unsigned first, Inner& to)
    {
        std::copy(children + first, children + count, to.children + to.count);
        std::copy(sizes + first, sizes + count, to.sizes + to.count);
        to.count = static_cast<std::uint8_t>(to.count + count - first);
        count = static_cast<std::uint8_t>(first);
    }

    Inner* parent = nullptr;  ///< Kept for an index only.
    Node* children[internal::FULL_INNER];
    std::uint32_t sizes[internal::FULL_INNER];  ///< How many entries lie below each child.
};

/// The way from the root to a leaf.
struct SequenceEntries::Path
{
    struct Step
    {
        Inner* node;
        unsigned child;
    };

    void add(Inner& node, unsigned child)
    {
        TARNKILN_ASSERT(length < internal::MAX_HEIGHT, "a tree of 32 children a node is low",
                        length);
        steps[length++] = {&node, child};
    }
    void addToSizes(std::uint32_t difference) const
    {
        for (unsigned i = 0; i < length; ++i)
            steps[i].node->sizes[steps[i].child] += difference;
    }

    Step steps[internal::MAX_HEIGHT];
    unsigned length = 0;
};

/// Of a full leaf or an inner node.
inline SequenceEntries::Inner*& SequenceEntries::parentOf(Node& node)
{
    if (node.level != 0)
        return static_cast<Inner&>(node).parent;
    return *reinterpret_cast<Inner**>(node.entries() + internal::FULL_LEAF);
}

inline void SequenceEntries::moveEntries(Node& from, unsigned first, Node& to, unsigned place,
                                         unsigned count) noexcept
{
    std::memmove(static_cast<void*>(to.entries() + place), from.entries() + first,
                 count * sizeof(ModelElement));
}
}  // namespace tarn::kiln::support
