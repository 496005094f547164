/// \file
/// How an element holds a collection that is made when it is first asked for.
#pragma once
#include <atomic>
#include <memory>

namespace tarn::kiln::support {

/// Owns a collection from its first use on; its address never changes.
///
/// Threads: elements of a frozen model may be read by several threads, so two of them may make the
/// collection at once: the first one to publish it wins.
template <class Collection> class LazyCollection
{
public:
    using Made = Collection;

    LazyCollection() = default;
    LazyCollection(LazyCollection const&) = delete;
    LazyCollection& operator=(LazyCollection const&) = delete;
    ~LazyCollection() { delete get(); }

    /// Null before the first use.
    Collection* get() const { return m_collection.load(std::memory_order_acquire); }

    /// Publishes `made` unless another one is there; true if it was the first.
    bool publish(std::unique_ptr<Collection> made)
    {
        Collection* present = nullptr;
        if (!m_collection.compare_exchange_strong(present, made.get(), std::memory_order_acq_rel))
            return false;
        static_cast<void>(made.release());
        return true;
    }

private:
    std::atomic<Collection*> m_collection{nullptr};
};
}  // namespace tarn::kiln::support
