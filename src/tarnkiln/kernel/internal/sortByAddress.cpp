#include "tarnkiln/kernel/internal/sortByAddress.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <utility>

namespace tarn::kiln::internal {
namespace {

constexpr int DIGIT_BITS = 11;
constexpr std::size_t DIGITS = std::size_t{1} << DIGIT_BITS;
constexpr std::size_t FEW = 1000;  ///< Fewer are compared faster than counted.

std::uintptr_t addressOf(ModelElement::Impl const* element)
{
    return reinterpret_cast<std::uintptr_t>(element);
}

/// Sorts by the digit that begins at the bit `shift` of the distance from `lowest`; equal ones stay
/// as they are.
void sortByDigit(std::vector<ModelElement::Impl*> const& from, std::vector<ModelElement::Impl*>& to,
                 std::uintptr_t lowest, int shift)
{
    auto const digitOf = [&](ModelElement::Impl const* element) {
        return (addressOf(element) - lowest) >> shift & (DIGITS - 1);
    };
    std::array<std::size_t, DIGITS> places{};
    for (ModelElement::Impl const* element : from)
        ++places[digitOf(element)];
    std::size_t before = 0;
    for (std::size_t& place : places)
        before += std::exchange(place, before);
    for (ModelElement::Impl* element : from)
        to[places[digitOf(element)]++] = element;
}
}  // namespace

void sortByAddress(std::vector<ModelElement::Impl*>& elements)
{
    if (elements.size() < FEW)
    {
        std::sort(elements.begin(), elements.end(), std::less<>());
        return;
    }
    auto const [lowest, highest] =
        std::minmax_element(elements.begin(), elements.end(), std::less<>());
    std::uintptr_t const begin = addressOf(*lowest);
    auto const bits = static_cast<int>(std::bit_width(addressOf(*highest) - begin));
    std::vector<ModelElement::Impl*> sorted(elements.size());
    for (int shift = std::countr_zero(alignof(std::max_align_t)); shift < bits; shift += DIGIT_BITS)
    {
        sortByDigit(elements, sorted, begin, shift);
        elements.swap(sorted);
    }
}
}  // namespace tarn::kiln::internal
