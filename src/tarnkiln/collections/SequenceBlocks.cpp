// How the tree of a sequence's entries changes its shape.
#include "tarnkiln/collections/internal/SequenceNodes.h"

#include <memory>
#include <new>
#include <numeric>
#include <utility>

namespace tarn::kiln::support {

using internal::FULL_INNER;
using internal::FULL_LEAF;
using internal::prefetchElements;

namespace {

/// A root leaf grows like a vector; 2, 4, 8, 16.
unsigned leafCapacityFor(unsigned count)
{
    unsigned capacity = 2;
    while (capacity < count)
        capacity *= 2;
    return std::min(capacity, FULL_LEAF);
}

/// The places behind the header; a full leaf has one more for its parent.
std::size_t leafBytes(unsigned capacity, std::size_t header)
{
    std::size_t const places = capacity == FULL_LEAF ? FULL_LEAF + 1 : capacity;
    return header + places * sizeof(ModelElement);
}
}  // namespace

SequenceEntries::Node* SequenceEntries::newLeaf(unsigned capacity)
{
    return new (::operator new(leafBytes(capacity, sizeof(Node)))) Node(/*atLevel=*/0, capacity);
}

/// Frees a leaf without entries.
void SequenceEntries::freeLeaf(Node* leaf) noexcept
{
    ::operator delete(leaf, leafBytes(leaf->capacity, sizeof(Node)));
}

void SequenceEntries::disown(Node* node) noexcept
{
    if (node->owners.decrement())
        release(node);
}

void SequenceEntries::release(Node* node) noexcept
{
    if (node->level == 0)
    {
        prefetchElements(node->entries(), node->count);
        std::destroy_n(node->entries(), node->count);
        freeLeaf(node);
        return;
    }
    auto* const inner = static_cast<Inner*>(node);
    std::for_each(inner->children, inner->children + inner->count, disown);
    delete inner;
}

std::size_t SequenceEntries::sizeOf(Node const& node)
{
    if (node.level == 0)
        return node.count;
    auto const& inner = static_cast<Inner const&>(node);
    return std::accumulate(inner.sizes, inner.sizes + inner.count, std::size_t{0});
}

SequenceEntries::Node* SequenceEntries::copyLeaf(Node& leaf, unsigned capacity)
{
    prefetchElements(leaf.entries(), leaf.count);
    Node* const copy = newLeaf(capacity);
    std::uninitialized_copy_n(leaf.entries(), leaf.count, copy->entries());
    copy->count = leaf.count;
    noteMoved(*copy, 0, copy->count);
    return copy;
}

SequenceEntries::Node* SequenceEntries::copyInner(Inner& inner)
{
    auto* const copy = new Inner(inner.level);
    std::copy_n(inner.children, inner.count, copy->children);
    std::copy_n(inner.sizes, inner.count, copy->sizes);
    copy->count = inner.count;
    for (unsigned i = 0; i < copy->count; ++i)
        copy->children[i]->owners.increment();
    adopt(*copy, 0, copy->count);
    return copy;
}

/// The child, which belongs to these entries alone from now on, as the parent does.
SequenceEntries::Node& SequenceEntries::unshare(Inner& parent, unsigned child)
{
    Node*& present = parent.children[child];
    if (present->owners.get() != 1)
    {
        Node* const copy = present->level == 0 ? copyLeaf(*present, FULL_LEAF)
                                               : copyInner(static_cast<Inner&>(*present));
        disown(std::exchange(present, copy));
        adopt(parent, child, child + 1);
    }
    return *present;
}

void SequenceEntries::unshareRoot()
{
    if (m_root->owners.get() == 1)
        return;
    Node* const copy = m_root->level == 0 ? copyLeaf(*m_root, leafCapacityFor(m_root->count))
                                          : copyInner(static_cast<Inner&>(*m_root));
    disown(std::exchange(m_root, copy));
}

/// Puts a new root above the present one.
void SequenceEntries::growRoot()
{
    auto* const root = new Inner(m_root->level + 1u);
    root->insertChild(0, m_root, m_size);
    m_root = root;
    adopt(*root, 0, 1);
}

/// The root belongs to these entries alone afterwards, and takes one more entry or child.
void SequenceEntries::makeRoomInRoot()
{
    if (!m_root)
        m_root = newLeaf(leafCapacityFor(1));
    if (m_root->count == (m_root->level == 0 ? FULL_LEAF : FULL_INNER))
    {
        unshareRoot();
        growRoot();
        return;
    }
    if (m_root->level != 0)
        return unshareRoot();
    bool const isShared = m_root->owners.get() != 1;
    if (!isShared && m_root->count < m_root->capacity)
        return;
    unsigned const capacity = leafCapacityFor(m_root->count + 1u);
    if (isShared)
    {
        disown(std::exchange(m_root, copyLeaf(*m_root, capacity)));
        return;
    }
    Node* const larger = newLeaf(capacity);
    moveEntries(*m_root, 0, *larger, 0, m_root->count);
    larger->count = m_root->count;
    freeLeaf(std::exchange(m_root, larger));
}

/// Gives what begins at `at` in the child to a new one behind it. Both nodes are ours alone.
void SequenceEntries::split(Inner& parent, unsigned child, unsigned at)
{
    Node& left = *parent.children[child];
    Node* right = nullptr;
    if (left.level == 0)
    {
        right = newLeaf(FULL_LEAF);
        moveEntries(left, at, *right, 0, left.count - at);
        right->count = static_cast<std::uint8_t>(left.count - at);
        left.count = static_cast<std::uint8_t>(at);
        noteMoved(*right, 0, right->count);
    }
    else
    {
        auto* const behind = new Inner(left.level);
        static_cast<Inner&>(left).moveChildren(at, *behind);
        adopt(*behind, 0, behind->count);
        right = behind;
    }
    std::size_t const moved = sizeOf(*right);
    parent.sizes[child] -= static_cast<std::uint32_t>(moved);
    parent.insertChild(child + 1, right, moved);
    adopt(parent, child + 1, child + 2);
}

/// The leaf with the entry at `index`, which becomes the place in it; ours alone, as the way to it.
SequenceEntries::Node& SequenceEntries::openLeaf(std::size_t& index, Path& path)
{
    TARNKILN_ASSERT(index < m_size, "positions are those of entries", index);
    unshareRoot();
    Node* node = m_root;
    std::size_t total = m_size;
    while (node->level != 0)
    {
        auto& inner = static_cast<Inner&>(*node);
        unsigned const child = inner.childAt(index, total);
        node = &unshare(inner, child);
        total = inner.sizes[child];
        path.add(inner, child);
    }
    return *node;
}

/// The same for an entry that is to come, with room for it. Full nodes on the way are split, in the
/// middle, or so that what is filled from one end leaves full nodes behind.
SequenceEntries::Node& SequenceEntries::openRoom(std::size_t& index, Path& path)
{
    bool const isFirst = index == 0;
    bool const isLast = index == m_size;
    makeRoomInRoot();
    Node* node = m_root;
    std::size_t total = m_size;
    while (node->level != 0)
    {
        auto& inner = static_cast<Inner&>(*node);
        unsigned child = inner.childAt(index, total);
        bool const isAboveLeaf = inner.level == 1;
        if (isAboveLeaf && index == 0 && child != 0)
            index = inner.sizes[--child];
        unsigned const count = unshare(inner, child).count;
        if (count == (isAboveLeaf ? FULL_LEAF : FULL_INNER))
        {
            unsigned at = count / 2;
            if (isAboveLeaf && (index == 0 || index == count))
                at = static_cast<unsigned>(index);
            else if (!isAboveLeaf && (isFirst || isLast))
                at = isFirst ? 1 : count - 1;
            split(inner, child, at);
            std::size_t const left = inner.sizes[child];
            if (index > left || (index == left && left == FULL_LEAF && isAboveLeaf))
            {
                index -= left;
                ++child;
            }
        }
        path.add(inner, child);
        node = inner.children[child];
        total = inner.sizes[child];
    }
    return *node;
}

/// The last leaf, if it has room and nothing is to be copied or split on the way to it; else null.
SequenceEntries::Node* SequenceEntries::openEnd()
{
    Node* node = m_root;
    while (node && node->level != 0)
    {
        auto const& inner = static_cast<Inner const&>(*node);
        node = inner.owners.get() == 1 ? inner.children[inner.count - 1u] : nullptr;
    }
    return node && node->owners.get() == 1 && node->count < node->capacity ? node : nullptr;
}

/// Joins the nodes on the way to a leaf from which an entry was taken with their neighbours, where
/// that needs no memory.
void SequenceEntries::shrink(Path const& path) noexcept
{
    for (unsigned i = path.length; i-- != 0;)
    {
        Inner& inner = *path.steps[i].node;
        unsigned const child = path.steps[i].child;
        if (inner.children[child]->count == 0)
        {
            disown(inner.children[child]);
            inner.removeChild(child);
        }
        else if (!join(inner, child) && !(child != 0 && join(inner, child - 1)))
        {
            break;
        }
    }
    lowerRoot();
}

/// Moves all of the right one of two small neighbours to the left one, if both are ours alone.
bool SequenceEntries::join(Inner& parent, unsigned left) noexcept
{
    if (left + 1u >= parent.count)
        return false;
    Node& to = *parent.children[left];
    unsigned const limit = to.level == 0 ? FULL_LEAF * 3 / 4 : FULL_INNER * 3 / 4;
    if (to.count >= limit)
        return false;
    Node& from = *parent.children[left + 1];
    if (to.count + from.count > static_cast<int>(limit) || to.owners.get() != 1 ||
        from.owners.get() != 1)
        return false;

    unsigned const before = to.count;
    if (to.level == 0)
    {
        moveEntries(from, 0, to, before, from.count);
        to.count = static_cast<std::uint8_t>(to.count + from.count);
        from.count = 0;
        noteMoved(to, before, to.count);
    }
    else
    {
        static_cast<Inner&>(from).moveChildren(0, static_cast<Inner&>(to));
        adopt(static_cast<Inner&>(to), before, to.count);
    }
    parent.sizes[left] += parent.sizes[left + 1];
    disown(&from);
    parent.removeChild(left + 1);
    return true;
}

/// Takes away a root above one node, or above none.
void SequenceEntries::lowerRoot() noexcept
{
    while (m_root->level != 0 && m_root->count < 2)
    {
        auto* const root = static_cast<Inner*>(m_root);
        m_root = root->count == 0 ? nullptr : root->children[0];
        if (!m_root)
            return delete root;
        m_root->owners.increment();
        disown(root);
    }
}
}  // namespace tarn::kiln::support
