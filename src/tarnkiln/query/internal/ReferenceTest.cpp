#include "tarnkiln/query/internal/ReferenceTest.h"

#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/UUIDHasher.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/internal/PlainPlace.h"
#include "tarnkiln/query/internal/RowIndex.h"

#include <algorithm>

namespace tarn::kiln::internal {
namespace {

/// The UUID that elements write as `text`; nothing if they write none so.
std::optional<UUID> parseUuid(ustring const& text)
{
    constexpr std::u16string_view FORM = u"xxxxxxxx-xxxx-xxxx-xxxx-xxxxxxxxxxxx";
    if (text.size() != FORM.size())
        return std::nullopt;
    UUID result{};
    std::size_t digits = 0;
    for (std::size_t at = 0; at < text.size(); ++at)
    {
        char16_t const letter = text[at];
        if (FORM[at] == u'-')
        {
            if (letter != u'-')
                return std::nullopt;
            continue;
        }
        bool const isDecimal = letter >= u'0' && letter <= u'9';
        if (!isDecimal && !(letter >= u'a' && letter <= u'f'))
            return std::nullopt;
        auto const digit = static_cast<unsigned>(isDecimal ? letter - u'0' : letter - u'a' + 10);
        std::uint8_t& byte = result.data[digits / 2];
        byte = static_cast<std::uint8_t>(byte << 4 | digit);
        ++digits;
    }
    return result;
}

std::size_t hashOf(ModelElement::Impl const* element)
{
    return reinterpret_cast<std::uintptr_t>(element) >> 4;
}

/// Whether a single value of the property can be read as an element.
bool isReference(meta::Property const& property)
{
    if (!property || property->getUpper() != 1)
        return false;
    auto const* const type = classImpl(property->getType());
    return type && type->isLive() && type->isA(ModelElement::metaClass());
}
}  // namespace

ReferenceTest::ReferenceTest(AssociatedObjectConstraint const& constraint, JoinSides const& sides,
                             Model const& model)
    : PairTest(sides),
      m_constraint(constraint),
      m_model(model),
      m_sourceSide(sides.ids[0] == constraint.getSource() ? 0 : 1),
      m_targetSide(sides.ids[0] == constraint.getTarget() ? 0 : 1),
      m_isSimple(isReference(constraint.getProperty()))
{}

bool ReferenceTest::matches(std::size_t first, std::size_t second)
{
    std::size_t const rows[] = {first, second};
    ModelElement::Impl* const target = m_sides.elements[m_targetSide][rows[m_targetSide]];
    Targets const& targets = targetsOf(rows[m_sourceSide]);
    return std::binary_search(targets.begin(), targets.end(), target);
}

ReferenceTest::Targets const& ReferenceTest::targetsOf(std::size_t row)
{
    if (m_targets.empty())
        m_targets.resize(m_sides.elements[m_sourceSide].size());
    std::optional<Targets>& targets = m_targets[row];
    if (!targets)
    {
        Targets found;
        readTargets(*m_sides.elements[m_sourceSide][row], found);
        targets = std::move(found);
    }
    return *targets;
}

void ReferenceTest::readTargets(ModelElement::Impl& source, Targets& targets)
{
    targets.clear();
    if (readSingleTarget(source, targets))
        return;
    for (ModelElement const& entry : m_constraint.readReferences(ModelElement(&source)))
    {
        if (ModelElement::Impl* const target = meaningOf(entry.getImpl()))
            targets.push_back(target);
    }
    std::sort(targets.begin(), targets.end());
    targets.erase(std::unique(targets.begin(), targets.end()), targets.end());
}

/// False if the source must be asked.
bool ReferenceTest::readSingleTarget(ModelElement::Impl const& source, Targets& targets)
{
    if (!m_isSimple)
        return false;
    meta::Property const& property = m_constraint.getProperty();
    ModelElement::Impl* entry = nullptr;
    std::type_info const& type = typeid(source);
    if (type == typeid(ReflectiveModelElementImpl))
    {
        ReflectiveCells const& cells = cellsOf(source);
        ReflectiveSlot const* const slot = cells.layout().find(property);
        if (!slot || slot->kind() != SlotKind::Reference ||
            !source.getMetaClass()->isATypeOf(property))
            return false;
        entry = cells.get(*slot).pointer<ModelElement::Impl>();
    }
    else
    {
        if (&type != m_lastType)
            m_lastField =
                source.isReadByFields() ? source.findStoredField(property) : StoredField();
        m_lastType = &type;
        if (!m_lastField.target)
            return false;
        entry = m_lastField.target(source);
    }
    if (ModelElement::Impl* const target = meaningOf(entry))
        targets.push_back(target);
    return true;
}

ModelElement::Impl* ReferenceTest::meaningOf(ModelElement::Impl* entry) const
{
    if (!entry || !entry->isLive() || !entry->isProxy())
        return entry;
    ustring const* const text = AssociatedObjectConstraint::getNamedUuid(ModelElement(entry));
    std::optional<UUID> const id = text ? parseUuid(*text) : std::nullopt;
    return id ? m_model->findElementImpl(*id) : nullptr;
}

std::optional<RowPairs> ReferenceTest::findMatches()
{
    auto const& sources = m_sides.elements[m_sourceSide];
    auto const& targets = m_sides.elements[m_targetSide];
    RowIndex index(targets.size());
    for (std::size_t row = targets.size(); row-- > 0;)
        index.addBefore(row, hashOf(targets[row]));

    RowPairs pairs;
    Targets found;
    std::vector<std::size_t> rows;
    for (std::size_t source = 0; source < sources.size(); ++source)
    {
        rows.clear();
        readTargets(*sources[source], found);
        for (ModelElement::Impl* const target : found)
        {
            for (std::size_t row = index.first(hashOf(target)); row != RowIndex::NONE;
                 row = index.next(row))
            {
                if (targets[row] == target)
                    rows.push_back(row);
            }
        }
        if (found.size() > 1)
            std::sort(rows.begin(), rows.end());
        for (std::size_t const row : rows)
            pairs.emplace_back(m_sourceSide == 0 ? source : row, m_sourceSide == 0 ? row : source);
    }
    if (m_sourceSide == 0)
        sortBySecond(pairs, targets.size());
    return pairs;
}
}  // namespace tarn::kiln::internal
