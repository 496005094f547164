#include "tarnkiln/meta/StandardTypes.h"

#include "tarnkiln/meta/MetaRegistry.h"

namespace tarn::kiln::meta {

constinit PrimitiveType StandardTypes::stringMeta;
constinit PrimitiveType StandardTypes::integerMeta;
constinit PrimitiveType StandardTypes::integer8Meta;
constinit PrimitiveType StandardTypes::integer16Meta;
constinit PrimitiveType StandardTypes::integer64Meta;
constinit PrimitiveType StandardTypes::realMeta;
constinit PrimitiveType StandardTypes::booleanMeta;
constinit PrimitiveType StandardTypes::unlimitedNaturalMeta;
constinit PrimitiveType StandardTypes::uinteger8Meta;
constinit PrimitiveType StandardTypes::uinteger16Meta;
constinit PrimitiveType StandardTypes::uinteger64Meta;
constinit PrimitiveType StandardTypes::uuidMeta;
constinit PrimitiveType StandardTypes::dateTimeMeta;
constinit PrimitiveType StandardTypes::stdstringMeta;
constinit PrimitiveType StandardTypes::hostArrayMeta;
constinit PrimitiveType StandardTypes::jsonValueMeta;
constinit PrimitiveType StandardTypes::stringToStringMapMeta;

void StandardTypes::ensureInitialized()
{
    MetaRegistry::getInstance();
}
}  // namespace tarn::kiln::meta
