/// \file
/// How an element holds the target of a single reference.
#pragma once
#include <cstddef>
#include <utility>

namespace tarn::kiln::support {

/// A counted pointer to an implementation object, which may be a proxy or dead.
///
/// `Impl` may be incomplete where the pointer is declared and read; what counts references needs
/// it complete.
template <class Impl> class CountedPointer
{
public:
    using Target = Impl;

    CountedPointer() = default;
    explicit CountedPointer(Impl* target) : m_target(target)
    {
        if (m_target)
            m_target->addRef();
    }
    CountedPointer(CountedPointer const& other) : CountedPointer(other.m_target) {}
    CountedPointer(CountedPointer&& other) noexcept
        : m_target(std::exchange(other.m_target, nullptr))
    {}
    ~CountedPointer()
    {
        if (m_target)
            m_target->removeRef();
    }
    CountedPointer& operator=(CountedPointer other) noexcept
    {
        std::swap(m_target, other.m_target);
        return *this;
    }

    Impl* get() const { return m_target; }
    explicit operator bool() const { return m_target != nullptr; }

private:
    Impl* m_target = nullptr;
};
}  // namespace tarn::kiln::support
