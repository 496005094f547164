/// \file
/// What all handles have in common.
#pragma once
#include "tarnkiln/kernel/ElementImpl.h"
#include "tarnkiln/kernel/UUIDHasher.h"

#include <concepts>
#include <cstddef>
#include <functional>
#include <iosfwd>
#include <utility>

namespace tarn::kiln {

/// A counted pointer to an implementation object, with reference semantics.
///
/// True while the object is there and not destroyed; equal to another handle of the same object.
/// Not for use by itself: `Model`, `ModelConstellation`, `ModelElement` and the classes derived
/// from it are the handles.
///
/// Threads: handles may be copied and dropped on any thread.
class TARNKILN_EXPORT ElementHandle
{
public:
    ElementHandle() = default;
    ElementHandle(ElementHandle const& other) noexcept : m_impl(other.m_impl)
    {
        if (m_impl)
            m_impl->addRef();
    }
    ElementHandle(ElementHandle&& other) noexcept : m_impl(std::exchange(other.m_impl, nullptr)) {}
    ~ElementHandle()
    {
        if (m_impl)
            m_impl->release();
    }
    ElementHandle& operator=(ElementHandle const& other)
    {
        if (this != &other)
        {
            if (other.m_impl)
                other.m_impl->addRef();
            if (ElementImpl* const old = std::exchange(m_impl, other.m_impl))
                old->release();
        }
        return *this;
    }
    /// Swaps: the other handle keeps this one's former target until it dies.
    ElementHandle& operator=(ElementHandle&& other) noexcept
    {
        if (this != &other)
            std::swap(m_impl, other.m_impl);
        return *this;
    }

    /// Whether there is an object and it is not destroyed.
    explicit operator bool() const noexcept { return m_impl && m_impl->isLive(); }
    bool operator==(ElementHandle const& other) const noexcept { return m_impl == other.m_impl; }
    /// By UUID, the empty handle first; two objects with one UUID by address.
    bool operator<(ElementHandle const& other) const noexcept
    {
        if (!m_impl || !other.m_impl || m_impl->getUuid() == other.m_impl->getUuid())
            return std::less<ElementImpl*>()(m_impl, other.m_impl);
        return m_impl->getUuid() < other.m_impl->getUuid();
    }

    /// The object, alive or dead; null for the empty handle.
    ElementImpl* getElementImpl() const noexcept { return m_impl; }

protected:
    explicit ElementHandle(ElementImpl* impl) noexcept : m_impl(impl)
    {
        if (m_impl)
            m_impl->addRef();
    }

    ElementImpl* m_impl = nullptr;
};

/// Shows the object behind a handle of any class to people: its class, its name or the URI of a
/// model if it has one, its UUID, and whether it is destroyed or stands in for another element.
///
///     Book "Emma" 8d5a0ea6-2f6b-4c1e-9f2c-0f8f3c1d7a52
///
/// The name is the property `name`, if the class has one that holds a single text. Resolves and
/// loads nothing, and may change with versions.
TARNKILN_EXPORT std::ostream& operator<<(std::ostream& out, ElementHandle const& handle);
}  // namespace tarn::kiln

/// By UUID; 0 for the empty handle.
template <> struct std::hash<tarn::kiln::ElementHandle>
{
    std::size_t operator()(tarn::kiln::ElementHandle const& handle) const noexcept
    {
        tarn::kiln::ElementImpl const* const impl = handle.getElementImpl();
        return impl ? tarn::kiln::internal::UUIDHasher()(impl->getUuid()) : 0;
    }
};

/// Handles of all classes hash as the object does.
template <std::derived_from<tarn::kiln::ElementHandle> Handle>
requires(!std::same_as<Handle, tarn::kiln::ElementHandle>) struct std::hash<Handle>
    : std::hash<tarn::kiln::ElementHandle>
{};
