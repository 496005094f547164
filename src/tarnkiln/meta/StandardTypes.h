/// \file
/// The primitive types that are always there.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/PrimitiveType.h"

namespace tarn::kiln::meta {

/// The handles of the primitive types, each under its bare name in the registry.
///
/// Danger: the handles are empty until the registry was started, which the first call of
/// `MetaRegistry::getInstance()` does. `Value` starts it by itself.
///
/// Threads: the handles are set once, while the registry starts, and may then be read anywhere.
class TARNKILN_EXPORT StandardTypes
{
public:
    StandardTypes() = delete;

    static PrimitiveType stringMeta;             ///< `String`: `ustring`
    static PrimitiveType integerMeta;            ///< `Integer`: `int`
    static PrimitiveType integer8Meta;           ///< `Integer8`: `signed char`
    static PrimitiveType integer16Meta;          ///< `Integer16`: `short`
    static PrimitiveType integer64Meta;          ///< `Integer64`: `long`
    static PrimitiveType realMeta;               ///< `Real`: `double`
    static PrimitiveType booleanMeta;            ///< `Boolean`: `bool`
    static PrimitiveType unlimitedNaturalMeta;   ///< `UnlimitedNatural`: `unsigned int`
    static PrimitiveType uinteger8Meta;          ///< `UInteger8`: `unsigned char`
    static PrimitiveType uinteger16Meta;         ///< `UInteger16`: `unsigned short`
    static PrimitiveType uinteger64Meta;         ///< `UInteger64`: `unsigned long`
    static PrimitiveType uuidMeta;               ///< `UUID`: `UUID`
    static PrimitiveType dateTimeMeta;           ///< `DateTime`: `boost::posix_time::ptime`
    static PrimitiveType stdstringMeta;          ///< `StdString`: `string`
    static PrimitiveType hostArrayMeta;          ///< `HostArray`: an array of a host environment
    static PrimitiveType jsonValueMeta;          ///< `JsonValue`: brought by clients
    static PrimitiveType stringToStringMapMeta;  ///< `StringToStringMap`: the collection

    /// Starts the registry if nobody has, so that the handles are set.
    static void ensureInitialized();

    /// The type of integers of 8, 16, 32 or 64 bits, with or without sign; empty for another
    /// width. The unsigned one of 32 bits is `UnlimitedNatural`.
    static Type getIntegralType(bool isSigned, int bits);

    /// Creates the types, in the order above, and registers them; called once, by the registry.
    static void initializeTypes(MetaRegistry& registry);
};
}  // namespace tarn::kiln::meta
