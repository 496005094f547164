#include "tarnkiln/collections/SequenceEntries.h"

#include "tarnkiln/Assert.h"
#include "tarnkiln/collections/internal/EntryIndex.h"

#include <cstring>
#include <new>
#include <numeric>

namespace tarn::kiln::support {
namespace {

constexpr unsigned FULL_LEAF = 31;  ///< With its parent behind, a leaf fills what malloc gives.
constexpr unsigned FULL_INNER = 32;
constexpr unsigned SMALL_LEAF = 12;  ///< A smaller one looks for a neighbour to join.
constexpr unsigned MAX_HEIGHT = 16;

/// From how many entries on an index is made, and down to how many it is kept.
constexpr std::size_t INDEX_FROM = 256;
constexpr std::size_t INDEX_TO = 128;
/// So many finders have searched all before an index is made, which costs as much as some of them.
constexpr std::uint8_t FAR_FINDS = 8;

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

/// Has the counts of elements at hand when they are about to change.
void prefetch(ModelElement const* first, std::size_t count)
{
    for (ModelElement const* each = first; each != first + count; ++each)
        __builtin_prefetch(each->getElementImpl(), /*rw=*/1);
}
}  // namespace

static_assert(sizeof(ModelElement) == sizeof(void*), "entries are moved as bytes");

struct SequenceEntries::Inner : Node
{
    explicit Inner(unsigned atLevel) : Node(atLevel, FULL_INNER) {}

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
    Node* children[FULL_INNER];
    std::uint32_t sizes[FULL_INNER];  ///< How many entries lie below each child.
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
        TARNKILN_ASSERT(length < MAX_HEIGHT, "a tree of 32 children a node is low", length);
        steps[length++] = {&node, child};
    }
    void addToSizes(std::uint32_t difference) const
    {
        for (unsigned i = 0; i < length; ++i)
            steps[i].node->sizes[steps[i].child] += difference;
    }

    Step steps[MAX_HEIGHT];
    unsigned length = 0;
};

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

void SequenceEntries::appendTo(std::vector<ModelElement>& list) const
{
    list.reserve(list.size() + m_size);
    for (Run run = runAt(0); run.first; run = runAt(run.end))
    {
        prefetch(run.first, run.end - run.begin);
        list.insert(list.end(), run.first, run.first + (run.end - run.begin));
    }
}

// ---------------------------------------------------------------------------- blocks

SequenceEntries::Node* SequenceEntries::newLeaf(unsigned capacity)
{
    return new (::operator new(leafBytes(capacity, sizeof(Node)))) Node(/*atLevel=*/0, capacity);
}

/// Frees a leaf without entries.
void SequenceEntries::freeLeaf(Node* leaf) noexcept
{
    ::operator delete(leaf, leafBytes(leaf->capacity, sizeof(Node)));
}

/// Of a full leaf or an inner node.
SequenceEntries::Inner*& SequenceEntries::parentOf(Node& node)
{
    if (node.level != 0)
        return static_cast<Inner&>(node).parent;
    return *reinterpret_cast<Inner**>(node.entries() + FULL_LEAF);
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
        prefetch(node->entries(), node->count);
        std::destroy_n(node->entries(), node->count);
        freeLeaf(node);
        return;
    }
    auto* const inner = static_cast<Inner*>(node);
    std::for_each(inner->children, inner->children + inner->count, disown);
    delete inner;
}

void SequenceEntries::moveEntries(Node& from, unsigned first, Node& to, unsigned place,
                                  unsigned count) noexcept
{
    std::memmove(static_cast<void*>(to.entries() + place), from.entries() + first,
                 count * sizeof(ModelElement));
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
    prefetch(leaf.entries(), leaf.count);
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

// ---------------------------------------------------------------------------- changing

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

// ---------------------------------------------------------------------------- finding

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
