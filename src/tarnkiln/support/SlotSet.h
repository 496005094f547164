/// \file
/// A small set of slot numbers.
#pragma once
#include <cstdint>
#include <memory>

namespace tarn::kiln::support {

/// Bits for a number of slots fixed at construction; up to 64 without an allocation.
class SlotSet
{
public:
    explicit SlotSet(unsigned long size)
        : m_size(size)
        , m_more(size > WORD ? std::make_unique<std::uint64_t[]>((size - 1) / WORD) : nullptr)
    {
    }

    bool test(unsigned long bit) const { return bit < m_size && (word(bit) >> bit % WORD & 1u); }
    void set(unsigned long bit, bool value = true)
    {
        if (bit >= m_size)
            return;
        std::uint64_t const mask = std::uint64_t{1} << bit % WORD;
        word(bit) = value ? word(bit) | mask : word(bit) & ~mask;
    }
    bool any() const
    {
        bool found = m_first != 0;
        for (unsigned long i = 0; !found && (i + 1) * WORD < m_size; ++i)
            found = m_more[i] != 0;
        return found;
    }

private:
    static constexpr unsigned long WORD = 64;

    std::uint64_t const& word(unsigned long bit) const
    {
        return bit < WORD ? m_first : m_more[bit / WORD - 1];
    }
    std::uint64_t& word(unsigned long bit)
    {
        return bit < WORD ? m_first : m_more[bit / WORD - 1];
    }

    unsigned long m_size;
    std::uint64_t m_first = 0;
    std::unique_ptr<std::uint64_t[]> m_more;
};
} // namespace tarn::kiln::support
