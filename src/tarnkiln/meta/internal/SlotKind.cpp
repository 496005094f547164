#include "tarnkiln/meta/internal/SlotKind.h"

#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/meta/StandardTypes.h"

namespace tarn::kiln::internal {

using meta::StandardTypes;

SlotKind plainKindOf(meta::Type const& type)
{
    struct Row
    {
        meta::Type const& type;
        SlotKind kind;
    };
    StandardTypes::ensureInitialized();
    static Row const rows[] = {
        {StandardTypes::stringMeta, SlotKind::String},
        {StandardTypes::integerMeta, SlotKind::Integer},
        {StandardTypes::integer8Meta, SlotKind::Integer8},
        {StandardTypes::integer16Meta, SlotKind::Integer16},
        {StandardTypes::integer64Meta, SlotKind::Integer64},
        {StandardTypes::realMeta, SlotKind::Real},
        {StandardTypes::booleanMeta, SlotKind::Boolean},
        {StandardTypes::unlimitedNaturalMeta, SlotKind::UnlimitedNatural},
        {StandardTypes::uinteger8Meta, SlotKind::UInteger8},
        {StandardTypes::uinteger16Meta, SlotKind::UInteger16},
        {StandardTypes::uinteger64Meta, SlotKind::UInteger64},
        {StandardTypes::uuidMeta, SlotKind::Uuid},
        {StandardTypes::dateTimeMeta, SlotKind::DateTime},
        {StandardTypes::stdstringMeta, SlotKind::StdString},
        {StandardTypes::stringToStringMapMeta, SlotKind::Annotations},
    };
    for (Row const& row : rows)
    {
        if (type == row.type)
            return row.kind;
    }
    return isEnumType(type) ? SlotKind::Enumeration : SlotKind::Other;
}
}  // namespace tarn::kiln::internal
