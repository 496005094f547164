#include "tarnkiln/query/internal/ComparisonTest.h"

#include "tarnkiln/kernel/UUIDHasher.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tarnkiln/meta/internal/PackedPayload.h"
#include "tarnkiln/meta/internal/PayloadAccess.h"
#include "tarnkiln/query/internal/RowIndex.h"
#include "tarnkiln/query/internal/prefetch.h"

#include <cstring>
#include <functional>
#include <string_view>

namespace tarn::kiln::internal {
namespace {

/// Equal payloads have equal hashes.
template <class T> std::size_t hashOf(T const& payload)
{
    if constexpr (std::is_same_v<T, UUID>)
    {
        return UUIDHasher()(payload);
    }
    else if constexpr (std::is_same_v<T, boost::posix_time::ptime>)
    {
        std::size_t bits = 0;
        static_assert(sizeof(payload) == sizeof bits);
        std::memcpy(&bits, &payload, sizeof bits);
        return bits;
    }
    else
    {
        return std::hash<T>()(payload);
    }
}

int literalAt(void const* payload)
{
    int number = 0;
    std::memcpy(&number, payload, sizeof number);
    return number;
}
}  // namespace

ComparisonTest::ComparisonTest(PropertyRelationPropertyJoinConstraint const& constraint,
                               JoinSides const& sides, JoinContext const& context)
    : PairTest(sides, context),
      m_constraint(constraint),
      m_comparator(context.regexes.withCache(constraint.getComparator())),
      m_leftSide(sides.ids[0] == constraint.getLeftInstance() ? 0 : 1)
{}

bool ComparisonTest::matches(std::size_t first, std::size_t second)
{
    std::size_t const rows[] = {first, second};
    Value const& left = valueOf(m_leftSide, rows[m_leftSide]);
    Value const& right = valueOf(1 - m_leftSide, rows[1 - m_leftSide]);
    return m_comparator(left, right);
}

Value const& ComparisonTest::valueOf(int side, std::size_t row)
{
    if (m_values[side].empty())
        m_values[side].resize(m_sides.elements[side].size());
    std::optional<Value>& value = m_values[side][row];
    if (!value)
        value.emplace(read(side, *m_sides.elements[side][row]));
    return *value;
}

Value ComparisonTest::read(int side, ModelElement::Impl& element) const
{
    m_context.holdElements();
    ModelElement const handle(&element);
    return side == m_leftSide ? m_constraint.readLeft(handle) : m_constraint.readRight(handle);
}

/// Unknown unless the element keeps a value of that kind where it can be looked at.
KeptValue ComparisonTest::Reader::read(ModelElement::Impl const& element, SlotKind kind)
{
    void const* const elementKind = m_kinds.of(element);
    if (elementKind != m_lastKind)
    {
        m_place = PlainPlace::find(element, keptBy(element), m_property);
        m_lastKind = elementKind;
    }
    return m_place.kind() == kind ? m_place.read(element) : KeptValue();
}

[[gnu::always_inline]] inline void
ComparisonTest::Reader::prefetch(ModelElement::Impl const& element) const
{
    internal::prefetch(&element);
    internal::prefetch(m_place.fieldOf(element));
}

/// Unknown if the value is not a single one of the kind.
template <class T>
KeptValue ComparisonTest::keptValueOf(int side, std::size_t row, Reader& reader, SlotKind kind)
{
    if constexpr (!std::is_same_v<T, ModelElement>)
    {
        KeptValue const kept = reader.read(*m_sides.elements[side][row], kind);
        if (kept.shape != KeptValue::Shape::Unknown)
            return kept;
    }
    Value const& value = valueOf(side, row);
    T const* const payload = support::PayloadAccess::get<T>(value);
    meta::Property const& property =
        side == m_leftSide ? m_constraint.getLeft() : m_constraint.getRight();
    // An absent literal may be of another type, and only its number counts.
    bool const isOdd = value.getFlags() > ValueFlags::Single ||
                       (value.getType() != property->getType() && payload) ||
                       (support::PayloadAccess::address(value) && !payload);
    if (isOdd || (value.getFlags() == ValueFlags::Single && !payload))
        return {};
    if (value.getFlags() == ValueFlags::Single)
        return keptValue(KeptValue::Shape::Single, payload);
    return keptValue(payload ? KeptValue::Shape::Optional : KeptValue::Shape::Absent, payload);
}

template <class T, class Hash, class Equal>
std::optional<RowPairs> ComparisonTest::findEqual(SlotKind kind, bool onlySingle, Hash const& hash,
                                                  Equal const& equal)
{
    std::vector<KeptValue> kept[2];
    for (int const side : {m_leftSide, 1 - m_leftSide})
    {
        Reader reader(side == m_leftSide ? m_constraint.getLeft() : m_constraint.getRight());
        std::size_t const rows = m_sides.elements[side].size();
        kept[side].reserve(rows);
        for (std::size_t row = 0; row < rows; ++row)
        {
            if (row + AHEAD < rows)
                reader.prefetch(*m_sides.elements[side][row + AHEAD]);
            kept[side].push_back(keptValueOf<T>(side, row, reader, kind));
            KeptValue::Shape const shape = kept[side].back().shape;
            if (shape == KeptValue::Shape::Unknown ||
                (onlySingle && shape != KeptValue::Shape::Single))
                return std::nullopt;
        }
    }

    auto const keyOf = [&](KeptValue const& value) {
        return value.payload ? hash(value) : std::size_t{0};
    };
    std::vector<std::size_t> hashes;
    hashes.reserve(kept[0].size());
    for (KeptValue const& value : kept[0])
        hashes.push_back(keyOf(value));
    RowIndex index(kept[0].size());
    for (std::size_t row = kept[0].size(); row-- > 0;)
        index.addBefore(row, hashes[row]);

    RowPairs pairs;
    for (std::size_t second = 0; second < kept[1].size(); ++second)
    {
        KeptValue const& value = kept[1][second];
        std::size_t const wanted = keyOf(value);
        for (std::size_t first = index.first(wanted); first != RowIndex::NONE;
             first = index.next(first))
        {
            if (hashes[first] == wanted && equal(kept[0][first], value))
                pairs.emplace_back(first, second);
        }
    }
    return pairs;
}

std::optional<RowPairs> ComparisonTest::findMatches()
{
    meta::Property const& left = m_constraint.getLeft();
    meta::Property const& right = m_constraint.getRight();
    if (m_constraint.getRelation() != ValueMatchRelation::equal || !left || !right ||
        left->getUpper() != 1 || right->getUpper() != 1)
        return std::nullopt;
    meta::Type const type = left->getType();
    if (!type || type != right->getType())
        return std::nullopt;

    if (classImpl(type))
    {
        auto const element = [](KeptValue const& value) {
            return payloadOf<ModelElement>(value).getElementImpl();
        };
        return findEqual<ModelElement>(
            SlotKind::Other, /*onlySingle=*/false,
            [&](KeptValue const& value) { return reinterpret_cast<std::size_t>(element(value)); },
            [&](KeptValue const& first, KeptValue const& second) {
                return element(first) == element(second);
            });
    }
    SlotKind const kind = plainKindOf(type);
    if (kind == SlotKind::Enumeration)
        return findEqualLiterals(type);
    if (kind >= SlotKind::Other)
        return std::nullopt;
    return withPayloadType(kind, [&]<class T>() {
        return findEqual<T>(
            kind, /*onlySingle=*/false,
            [](KeptValue const& value) { return hashOf(payloadOf<T>(value)); },
            [](KeptValue const& first, KeptValue const& second) {
                return first.shape == second.shape &&
                       (!first.payload || payloadOf<T>(first) == payloadOf<T>(second));
            });
    });
}

/// Literals are equal by number, whatever their shape; absent ones are, too. Where a literal is
/// required an optional one fails, and all pairs must be tried to see at which.
std::optional<RowPairs> ComparisonTest::findEqualLiterals(meta::Type const& type)
{
    bool const required =
        &m_comparator == query::ValueComparatorRegistry::getInstance().findComparator(
                             ValueMatchRelation::equal, type, /*required=*/true);
    return findEqual<unsigned long>(
        SlotKind::Enumeration, /*onlySingle=*/required,
        [](KeptValue const& value) { return static_cast<std::size_t>(literalAt(value.payload)); },
        [](KeptValue const& first, KeptValue const& second) {
            if (!first.payload || !second.payload)
                return first.payload == second.payload;
            return literalAt(first.payload) == literalAt(second.payload);
        });
}
}  // namespace tarn::kiln::internal
