/// \file
/// A small set of slot numbers.
#pragma once
#include <cstdint>

namespace tarn::kiln::support {

/// Bits for a number of slots fixed at construction; up to 64 without an allocation.
class SlotSet
{
public:
    explicit SlotSet(unsigned long size) : m_size(static_cast<std::uint32_t>(size))
    {
        if (isLarge())
            m_words = new std::uint64_t[wordCount()]();
        else
            m_word = 0;
    }
    SlotSet(SlotSet const&) = delete;
    SlotSet& operator=(SlotSet const&) = delete;
    ~SlotSet()
    {
        if (isLarge())
            delete[] m_words;
    }

    unsigned long size() const { return m_size; }
    bool test(unsigned long bit) const
    {
        return bit < m_size && (words()[bit / WORD] >> bit % WORD & 1u);
    }
    void set(unsigned long bit, bool value = true)
    {
        if (bit >= m_size)
            return;
        std::uint64_t const mask = std::uint64_t{1} << bit % WORD;
        std::uint64_t& word = const_cast<std::uint64_t*>(words())[bit / WORD];
        word = value ? word | mask : word & ~mask;
    }
    bool any() const
    {
        for (unsigned long i = 0; i < wordCount(); ++i)
        {
            if (words()[i] != 0)
                return true;
        }
        return false;
    }

private:
    static constexpr unsigned long WORD = 64;

    bool isLarge() const { return m_size > WORD; }
    unsigned long wordCount() const { return (m_size + WORD - 1) / WORD; }
    std::uint64_t const* words() const { return isLarge() ? m_words : &m_word; }

    union
    {
        std::uint64_t m_word;
        std::uint64_t* m_words;  ///< Owned; of a large set.
    };
    std::uint32_t m_size;
};
}  // namespace tarn::kiln::support
