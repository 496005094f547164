/// \file
/// The counted pointer to a change record.
#pragma once
#include "tarnkiln/kernel/Changes.h"

#include <utility>

namespace tarn::kiln {

/// Shares a change record and deletes it with the last holder.
///
/// Threads: the count is plain; records never leave the thread of their transaction.
class TARNKILN_EXPORT ChangesHolder
{
public:
    ChangesHolder() = default;
    /// Takes a share in `changes`, which may be null.
    explicit ChangesHolder(ModelElement::Impl::Changes* changes) : m_changes(changes)
    {
        if (m_changes)
            ++m_changes->m_holderCount;
    }
    ChangesHolder(ChangesHolder const& other) : ChangesHolder(other.m_changes) {}
    ChangesHolder(ChangesHolder&& other) noexcept
        : m_changes(std::exchange(other.m_changes, nullptr))
    {}
    ~ChangesHolder()
    {
        if (m_changes && --m_changes->m_holderCount == 0)
            delete m_changes;
    }
    ChangesHolder& operator=(ChangesHolder other) noexcept
    {
        swap(other);
        return *this;
    }

    void swap(ChangesHolder& other) noexcept { std::swap(m_changes, other.m_changes); }
    explicit operator bool() const { return m_changes != nullptr; }
    ModelElement::Impl::Changes* get() const { return m_changes; }
    ModelElement::Impl::Changes* operator->() const { return m_changes; }
    ModelElement::Impl::Changes& operator*() const { return *m_changes; }

private:
    ModelElement::Impl::Changes* m_changes = nullptr;
};
}  // namespace tarn::kiln
