#include "tarnkiln/collections/SequenceEntries.h"

#include "tarnkiln/collections/internal/EntryIndex.h"
#include "tarnkiln/collections/internal/SequenceNodes.h"

#include <algorithm>
#include <new>
#include <utility>

namespace tarn::kiln::support {

using internal::FULL_LEAF;
using internal::prefetchElements;
using internal::SMALL_LEAF;

namespace {

/// Down to so many entries an index is kept.
constexpr std::size_t INDEX_TO = 128;
}  // namespace

// ---------------------------------------------------------------------------- the whole

SequenceEntries::SequenceEntries() noexcept = default;

SequenceEntries::SequenceEntries(SequenceEntries const& other) noexcept
    : m_root(other.m_root),
      m_size(other.m_size),
      m_mayHoldProxies(other.m_mayHoldProxies),
      m_holdsTwice(other.m_holdsTwice)
{
    if (m_root)
        m_root->owners.increment();
}

SequenceEntries::SequenceEntries(SequenceEntries&& other) noexcept
{
    swap(other);
}

SequenceEntries::~SequenceEntries()
{
    if (m_root)
        disown(m_root);
}

/// Indexes go, since only one of those that share blocks may have one.
void SequenceEntries::swap(SequenceEntries& other) noexcept
{
    m_index.reset();
    other.m_index.reset();
    std::swap(m_root, other.m_root);
    std::swap(m_size, other.m_size);
    std::swap(m_lastChange, other.m_lastChange);
    std::swap(m_farFinds, other.m_farFinds);
    std::swap(m_mayHoldProxies, other.m_mayHoldProxies);
    std::swap(m_holdsTwice, other.m_holdsTwice);
    m_version = other.m_version = std::max(m_version, other.m_version) + 1;
}

SequenceEntries SequenceEntries::duplicate() const
{
    SequenceEntries result;
    forEach([&](ModelElement const& entry) { result.append(entry); });
    return result;
}

// ---------------------------------------------------------------------------- reading

ModelElement const& SequenceEntries::nothing()
{
    static ModelElement const empty;
    return empty;
}

SequenceEntries::Run SequenceEntries::runAt(std::size_t index) const
{
    if (index >= m_size)
        return {};
    Node* node = m_root;
    std::size_t begin = index;
    std::size_t total = m_size;
    while (node->level != 0)
    {
        auto const& inner = static_cast<Inner const&>(*node);
        unsigned const child = inner.childAt(index, total);
        node = inner.children[child];
        total = inner.sizes[child];
    }
    begin -= index;
    return {node->entries(), begin, begin + node->count};
}

void SequenceEntries::appendTo(std::vector<ModelElement>& list) const
{
    list.reserve(list.size() + m_size);
    for (Run run = runAt(0); run.first; run = runAt(run.end))
    {
        prefetchElements(run.first, run.end - run.begin);
        list.insert(list.end(), run.first, run.first + (run.end - run.begin));
    }
}

// ---------------------------------------------------------------------------- changing

void SequenceEntries::noteLeaving(ModelElement const& element) noexcept
{
    if (m_index)
        m_index->remove(element.getImpl());
}

void SequenceEntries::noteEntering(ModelElement const& element, Node& leaf) noexcept
{
    ModelElement::Impl const* const impl = element.getImpl();
    if (impl && impl->isProxy())
        m_mayHoldProxies = true;
    if (m_index)
        addEntering(element, leaf);
}

void SequenceEntries::noteChange(std::size_t index) noexcept
{
    ++m_version;
    m_lastChange = static_cast<std::uint32_t>(index);
}

/// Enters what has the place `at` in a leaf, in which there is room, and `index` among all.
void SequenceEntries::place(ModelElement&& element, std::size_t index, Node& leaf,
                            unsigned at) noexcept
{
    ModelElement const& added = *new (leaf.entries() + at) ModelElement(std::move(element));
    ++leaf.count;
    ++m_size;
    noteEntering(added, leaf);
    noteChange(index);
}

/// Mostly there is room at the end, and nothing to be looked for.
void SequenceEntries::append(ModelElement element)
{
    Node* const leaf = openEnd();
    if (!leaf)
        return insert(m_size, std::move(element));
    for (Node* node = m_root; node != leaf;)
    {
        auto& inner = static_cast<Inner&>(*node);
        ++inner.sizes[inner.count - 1u];
        node = inner.children[inner.count - 1u];
    }
    place(std::move(element), m_size, *leaf, leaf->count);
}

void SequenceEntries::insert(std::size_t index, ModelElement element)
{
    Path path;
    std::size_t there = index;
    Node& leaf = openRoom(there, path);
    auto const at = static_cast<unsigned>(there);
    moveEntries(leaf, at, leaf, at + 1, leaf.count - at);
    path.addToSizes(1);
    place(std::move(element), index, leaf, at);
}

ModelElement SequenceEntries::take(std::size_t index)
{
    Path path;
    std::size_t place = index;
    Node& leaf = openLeaf(place, path);
    auto const at = static_cast<unsigned>(place);
    ModelElement taken = std::move(leaf.entries()[at]);
    noteLeaving(taken);
    --leaf.count;
    moveEntries(leaf, at + 1, leaf, at, leaf.count - at);
    path.addToSizes(~std::uint32_t{0});
    --m_size;
    noteChange(index);
    if (leaf.count < SMALL_LEAF)
        shrink(path);
    if (m_size < INDEX_TO)
        m_index.reset();
    return taken;
}

ModelElement SequenceEntries::exchange(std::size_t index, ModelElement element)
{
    Path path;
    std::size_t place = index;
    Node& leaf = openLeaf(place, path);
    ModelElement& present = leaf.entries()[place];
    ModelElement replaced = std::exchange(present, std::move(element));
    noteLeaving(replaced);
    noteEntering(present, leaf);
    noteChange(index);
    return replaced;
}

void SequenceEntries::swapEntries(std::size_t left, std::size_t right)
{
    Path leftPath;
    Path rightPath;
    std::size_t leftPlace = left;
    std::size_t rightPlace = right;
    Node& leftLeaf = openLeaf(leftPlace, leftPath);
    Node& rightLeaf = openLeaf(rightPlace, rightPath);
    std::swap(leftLeaf.entries()[leftPlace], rightLeaf.entries()[rightPlace]);
    auto const first = static_cast<unsigned>(leftPlace);
    auto const second = static_cast<unsigned>(rightPlace);
    noteMoved(leftLeaf, first, first + 1);
    noteMoved(rightLeaf, second, second + 1);
    noteChange(left);
}

// ---------------------------------------------------------------------------- validation

bool SequenceEntries::isSound() const
{
    return !m_root ? m_size == 0 : sizeOf(*m_root) == m_size && isSound(*m_root, nullptr);
}

bool SequenceEntries::isSound(Node& node, Inner* parent) const
{
    bool const isRoot = &node == m_root;
    if (node.owners.get() == 0 || node.count > node.capacity || (node.count == 0 && !isRoot) ||
        (m_index && !isRoot && parentOf(node) != parent))
        return false;
    if (node.level == 0)
        return (isRoot || node.capacity == FULL_LEAF) &&
               (!m_index || std::all_of(node.entries(), node.entries() + node.count,
                                        [&](ModelElement const& entry) {
                                            return m_index->find(entry.getImpl()) == &node;
                                        }));
    auto& inner = static_cast<Inner&>(node);
    for (unsigned i = 0; i < inner.count; ++i)
    {
        Node& child = *inner.children[i];
        if (child.level + 1 != node.level || sizeOf(child) != inner.sizes[i] ||
            !isSound(child, &inner))
            return false;
    }
    return true;
}
}  // namespace tarn::kiln::support
