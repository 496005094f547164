#include "tarnkiln/collections/internal/EntryIndex.h"

#include <bit>
#include <cstdint>

namespace tarn::kiln::internal {
namespace {

/// Places for `count` elements of which a quarter at least stays free.
std::size_t placesFor(std::size_t count)
{
    return std::bit_ceil(count + count / 2 + 8);
}
}  // namespace

EntryIndex::EntryIndex(std::size_t count) : m_places(placesFor(count)) {}

/// The upper bits of a product, since addresses differ in their middle bits.
std::size_t EntryIndex::home(ModelElement::Impl const* element) const
{
    auto const address = reinterpret_cast<std::uintptr_t>(element);
    int const bits = std::countr_zero(m_places.size());
    return static_cast<std::size_t>((address * 0x9E3779B97F4A7C15u) >> (64 - bits));
}

/// That of `element`, or the free one where it would go.
std::size_t EntryIndex::findPlace(ModelElement::Impl const* element) const
{
    std::size_t place = home(element);
    while (m_places[place].element && m_places[place].element != element)
        place = next(place);
    return place;
}

EntryIndex::Leaf* EntryIndex::find(ModelElement::Impl const* element) const
{
    return m_places[findPlace(element)].leaf;
}

bool EntryIndex::add(ModelElement::Impl const* element, Leaf* leaf)
{
    if (!element)
        return false;
    if (m_count + m_count / 3 >= m_places.size())
        grow();
    Place& place = m_places[findPlace(element)];
    if (place.element)
        return false;
    place = {element, leaf};
    ++m_count;
    return true;
}

void EntryIndex::move(ModelElement::Impl const* element, Leaf* leaf) noexcept
{
    Place& place = m_places[findPlace(element)];
    if (place.element)
        place.leaf = leaf;
}

/// Those behind move up, so that none is cut off from its home.
void EntryIndex::remove(ModelElement::Impl const* element) noexcept
{
    std::size_t freed = findPlace(element);
    if (!m_places[freed].element)
        return;
    std::size_t const mask = m_places.size() - 1;
    for (std::size_t at = next(freed); m_places[at].element; at = next(at))
    {
        std::size_t const distance = (at - home(m_places[at].element)) & mask;
        if (distance >= ((at - freed) & mask))
        {
            m_places[freed] = m_places[at];
            freed = at;
        }
    }
    m_places[freed] = {};
    --m_count;
}

void EntryIndex::grow()
{
    std::vector<Place> const before =
        std::exchange(m_places, std::vector<Place>(placesFor(m_count * 2)));
    for (Place const& each : before)
    {
        if (each.element)
            m_places[findPlace(each.element)] = each;
    }
}
}  // namespace tarn::kiln::internal
