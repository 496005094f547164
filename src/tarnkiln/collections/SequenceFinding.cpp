// How the place of an entry is found: near the last change, by an index, or from the front.
#include "tarnkiln/collections/internal/EntryIndex.h"
#include "tarnkiln/collections/internal/SequenceNodes.h"

#include <algorithm>
#include <memory>
#include <new>

namespace tarn::kiln::support {

using internal::FULL_LEAF;

namespace {

/// From how many entries on an index is made.
constexpr std::size_t INDEX_FROM = 256;
/// So many finders have searched all before an index is made, which costs as much as some of them.
constexpr std::uint8_t FAR_FINDS = 8;
}  // namespace

std::size_t SequenceEntries::findFirst(ModelElement const& element) const
{
    return m_index ? lookUp(element) : scan(element);
}

std::size_t SequenceEntries::scan(ModelElement const& element) const
{
    for (Run run = runAt(0); run.first; run = runAt(run.end))
    {
        std::size_t const place = run.find(element);
        if (place != run.end)
            return place;
    }
    return m_size;
}

std::size_t SequenceEntries::findForChange(ModelElement const& element, bool mustBeFirst)
{
    if (m_index)
        return lookUp(element);
    if (m_size <= FULL_LEAF)
        return scan(element);
    if (!mustBeFirst)
    {
        std::size_t const place = findNear(element);
        if (place != m_size)
            return place;
    }
    if (m_size >= INDEX_FROM && !m_holdsTwice && m_farFinds++ == FAR_FINDS)
    {
        m_farFinds = 0;
        buildIndex();
    }
    return findFirst(element);
}

/// Where the last change was, beside that, and at both ends.
std::size_t SequenceEntries::findNear(ModelElement const& element) const
{
    Run const around = runAt(std::min<std::size_t>(m_lastChange, m_size - 1));
    if (std::size_t const place = around.find(element); place != around.end)
        return place;
    std::size_t const before = around.begin == 0 ? 0 : around.begin - 1;
    for (std::size_t const there : {std::size_t{m_size} - 1, around.end, before, std::size_t{0}})
    {
        Run const run = runAt(there);
        if (std::size_t const place = run.find(element); place != run.end)
            return place;
    }
    return m_size;
}

/// By the index, of which only whoever changes these entries knows.
std::size_t SequenceEntries::lookUp(ModelElement const& element) const
{
    Node* node = m_index->find(element.getImpl());
    if (!node)
        return m_size;
    ModelElement const* const entries = node->entries();
    auto place =
        static_cast<std::size_t>(std::find(entries, entries + node->count, element) - entries);
    while (node != m_root)
    {
        Inner* const parent = parentOf(*node);
        for (unsigned child = 0; parent->children[child] != node; ++child)
            place += parent->sizes[child];
        node = parent;
    }
    return place;
}

void SequenceEntries::addEntering(ModelElement const& element, Node& leaf) noexcept
{
    try
    {
        m_holdsTwice = !m_index->add(element.getImpl(), &leaf);
        if (m_holdsTwice)
            m_index.reset();
    }
    catch (std::bad_alloc const&)
    {
        m_index.reset();  // it only saves time
    }
}

/// Tells the index that these entries are in this leaf now.
void SequenceEntries::noteMoved(Node& leaf, unsigned first, unsigned last) noexcept
{
    if (!m_index)
        return;
    for (unsigned i = first; i != last; ++i)
        m_index->move(leaf.entries()[i].getImpl(), &leaf);
}

/// Tells the children whose they are, as long as there is an index.
void SequenceEntries::adopt(Inner& parent, unsigned first, unsigned last) noexcept
{
    if (!m_index)
        return;
    for (unsigned i = first; i != last; ++i)
        parentOf(*parent.children[i]) = &parent;
}

/// Does without if there is no memory or if an entry is in here twice.
void SequenceEntries::buildIndex() noexcept
{
    try
    {
        m_index = std::make_unique<internal::EntryIndex>(m_size);
        m_holdsTwice = !addToIndex(*m_root);
        if (m_holdsTwice)
            m_index.reset();
    }
    catch (std::bad_alloc const&)
    {
        m_index.reset();
    }
}

/// False if an entry was there before.
bool SequenceEntries::addToIndex(Node& node)
{
    if (node.level == 0)
        return std::all_of(
            node.entries(), node.entries() + node.count,
            [&](ModelElement const& entry) { return m_index->add(entry.getImpl(), &node); });
    auto& inner = static_cast<Inner&>(node);
    adopt(inner, 0, inner.count);
    return std::all_of(inner.children, inner.children + inner.count,
                       [&](Node* child) { return addToIndex(*child); });
}
}  // namespace tarn::kiln::support
