/// \file
/// A table that many threads read and few change.
#pragma once
#include <atomic>
#include <memory>
#include <mutex>
#include <utility>

namespace tarn::kiln::internal {

/// Leads readers to the latest copy of a table, which no one changes any more.
///
/// A thread keeps the copy that it read last. To see that it is still the latest it reads one word,
/// and it writes nothing that others read; so readers cost each other nothing. A copy dies with the
/// last thread that keeps it.
///
/// There must be one `Published` for each type of table, which lives to the end of the process.
///
/// Threads: `publish` is called by one at a time, the others on any.
template <class Table> class Published
{
public:
    /// The latest copy, good until this thread's next call; null if there is none, and at the end
    /// of a thread.
    Table const* find() const
    {
        Table const* const latest = m_latest.load(std::memory_order_acquire);
        if (!latest || kept.isOver)
            return nullptr;
        return latest == kept.table ? latest : keepLatest();
    }
    /// Whether `table` is the latest copy.
    bool isLatest(Table const* table) const
    {
        return table == m_latest.load(std::memory_order_acquire);
    }

    /// Lets `copy` be the latest; null for none.
    void publish(std::shared_ptr<Table const> copy)
    {
        std::lock_guard const lock(m_mutex);
        m_latest.store(copy.get(), std::memory_order_release);
        m_owner.swap(copy);
    }

private:
    /// What a thread keeps. Static objects may read after the thread's own objects are gone, so
    /// what tells of that has no destructor.
    struct Kept
    {
        struct Holder
        {
            ~Holder() { kept.isOver = true; }
            std::shared_ptr<Table const> table;
        };

        void set(std::shared_ptr<Table const> const& latest)
        {
            thread_local Holder holder;
            holder.table = latest;
            table = latest.get();
        }

        Table const* table = nullptr;
        bool isOver = false;
    };

    Table const* keepLatest() const
    {
        std::shared_ptr<Table const> owner;
        {
            std::lock_guard const lock(m_mutex);
            owner = m_owner;
        }
        kept.set(owner);
        return owner.get();
    }

    static inline thread_local constinit Kept kept{};

    std::atomic<Table const*> m_latest{nullptr};
    mutable std::mutex m_mutex;  ///< Held for as long as it takes to copy a pointer.
    std::shared_ptr<Table const> m_owner;
};
}  // namespace tarn::kiln::internal
