/// \file
/// How `ElementSequence` stores its entries.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElementImpl.h"
#include "tarnkiln/support/SharedCount.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln::internal {
class EntryIndex;
}

namespace tarn::kiln::support {

/// Counted handles in an order, in blocks that several of these share until one changes.
///
/// A copy costs the same whatever it holds. The first change after that copies the one block that
/// it touches, and the way to it; the others stay shared. Up to 31 entries are one block, which
/// grows like a `std::vector`; more are the leaves of a tree in which each node knows how many
/// entries lie below it:
///
/// | Operation | Steps |
/// |---|---|
/// | `operator[]`, `insert`, `take`, `exchange` | log n |
/// | copying, `swap` | 1 |
/// | walking from `runAt` to `runAt` | log n for 31 entries |
/// | `findFirst`, `findForChange` | n, or log n after a few that had to search far |
///
/// Entries are moved, never counted up and down, when others make them change their places. What
/// throws leaves the entries as they were. A finder may make an index of what is in here; only
/// one of those that share a block may have one, hence snapshots must not call `findForChange`.
///
/// Threads: as the collection. Blocks may be shared by snapshots that another thread drops.
class TARNKILN_EXPORT SequenceEntries
{
public:
    /// Entries that lie side by side, `first` at the position `begin`. Valid until the next change.
    struct Run
    {
        ModelElement const* first = nullptr;
        std::size_t begin = 0;
        std::size_t end = 0;

        /// The first position of `element`; `end` if it is not among these.
        std::size_t find(ModelElement const& element) const
        {
            return begin + static_cast<std::size_t>(
                               std::find(first, first + (end - begin), element) - first);
        }
    };

    SequenceEntries() noexcept;
    SequenceEntries(SequenceEntries const& other) noexcept;  ///< Shares all blocks of `other`.
    SequenceEntries(SequenceEntries&& other) noexcept;
    SequenceEntries& operator=(SequenceEntries other) noexcept
    {
        swap(other);
        return *this;
    }
    ~SequenceEntries();

    /// \name Reading
    /// @{
    std::size_t size() const { return m_size; }
    bool empty() const { return m_size == 0; }
    /// The entry; an empty handle behind the last one.
    ModelElement const& operator[](std::size_t index) const
    {
        if (m_root && m_root->level == 0 && index < m_size)
            return m_root->entries()[index];
        Run const run = runAt(index);
        return run.first ? run.first[index - run.begin] : nothing();
    }
    /// The entries around that at `index`; none behind the last one.
    Run runAt(std::size_t index) const;
    /// Differs after each change from what it was before.
    std::uint32_t version() const { return m_version; }
    /// False only if no proxy has ever been put in here.
    bool mayHoldProxies() const { return m_mayHoldProxies; }
    /// The first position of `element`; `size()` if it is absent.
    std::size_t findFirst(ModelElement const& element) const;
    /// Calls `visit(ModelElement const&)` for all, which must not change anything in here.
    template <class Visit> void forEach(Visit const& visit) const
    {
        for (Run run = runAt(0); run.first; run = runAt(run.end))
            std::for_each(run.first, run.first + (run.end - run.begin), visit);
    }
    /// Appends handles of all entries to `list`.
    void appendTo(std::vector<ModelElement>& list) const;
    /// The same entries in blocks that are not shared with these.
    SequenceEntries duplicate() const;
    /// Whether the blocks fit together; for tests and assertions. Visits all.
    bool isSound() const;
    /// @}

    /// \name Changing
    /// Positions must exist, or be `size()` for `insert`.
    /// @{
    void append(ModelElement element);
    void insert(std::size_t index, ModelElement element);
    /// Removes the entry and hands it out.
    [[nodiscard]] ModelElement take(std::size_t index);
    /// Puts `element` in the place of the entry, which is handed out.
    ModelElement exchange(std::size_t index, ModelElement element);
    void swapEntries(std::size_t left, std::size_t right);
    void swap(SequenceEntries& other) noexcept;
    /// A position of `element`, which is about to leave or to be added; `size()` if it is absent.
    /// Looks first at both ends and where the last change was, unless it must be the first place.
    std::size_t findForChange(ModelElement const& element, bool mustBeFirst);
    /// @}

private:
    friend class internal::EntryIndex;

    struct alignas(void*) Node
    {
        support::SharedCount owners{1};
        std::uint8_t level;  ///< 0 for a leaf, whose entries lie behind.
        std::uint8_t count;  ///< Of entries or children.
        std::uint8_t capacity;

        Node(unsigned atLevel, unsigned room)
            : level(static_cast<std::uint8_t>(atLevel)),
              count(0),
              capacity(static_cast<std::uint8_t>(room))
        {}
        ModelElement* entries() { return reinterpret_cast<ModelElement*>(this + 1); }
    };
    struct Inner;
    struct Path;

    static ModelElement const& nothing();
    static Node* newLeaf(unsigned capacity);
    static void freeLeaf(Node* leaf) noexcept;
    static Inner*& parentOf(Node& node);
    static void disown(Node* node) noexcept;
    static void release(Node* node) noexcept;
    static void moveEntries(Node& from, unsigned first, Node& to, unsigned place,
                            unsigned count) noexcept;
    static std::size_t sizeOf(Node const& node);

    // All but the last three leave the entries as they are, whether they throw or not.
    Node* copyLeaf(Node& leaf, unsigned capacity);
    Node* copyInner(Inner& inner);
    Node& unshare(Inner& parent, unsigned child);
    void unshareRoot();
    void growRoot();
    void makeRoomInRoot();
    void split(Inner& parent, unsigned child, unsigned at);
    Node& openLeaf(std::size_t& index, Path& path);
    Node& openRoom(std::size_t& index, Path& path);
    Node* openEnd();
    void shrink(Path const& path) noexcept;
    bool join(Inner& parent, unsigned left) noexcept;
    void lowerRoot() noexcept;
    void place(ModelElement&& element, std::size_t index, Node& leaf, unsigned at) noexcept;
    void noteLeaving(ModelElement const& element) noexcept;
    void noteEntering(ModelElement const& element, Node& leaf) noexcept;
    void addEntering(ModelElement const& element, Node& leaf) noexcept;
    void noteChange(std::size_t index) noexcept;

    std::size_t scan(ModelElement const& element) const;
    std::size_t findNear(ModelElement const& element) const;
    std::size_t lookUp(ModelElement const& element) const;
    void adopt(Inner& parent, unsigned first, unsigned last) noexcept;
    void noteMoved(Node& leaf, unsigned first, unsigned last) noexcept;
    void buildIndex() noexcept;
    bool addToIndex(Node& node);
    bool isSound(Node& node, Inner* parent) const;

    Node* m_root = nullptr;
    std::unique_ptr<internal::EntryIndex> m_index;  ///< Null until finding by far pays.
    std::uint32_t m_size = 0;
    std::uint32_t m_version = 0;
    std::uint32_t m_lastChange = 0;  ///< The position of it.
    std::uint8_t m_farFinds = 0;     ///< How many finders had to search all, up to a limit.
    bool m_mayHoldProxies = false;
    bool m_holdsTwice = false;  ///< An index has seen an entry that was in here already.
};
}  // namespace tarn::kiln::support
