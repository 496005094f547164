#include "tarnkiln/meta/ExtensionPrototypeDatatypeSerializer.h"

namespace tarn::kiln::meta {

using Prototype = ExtensionPrototype;

ExtensionPrototypeDatatypeSerializer::ExtensionPrototypeDatatypeSerializer(DataType const& type)
    : DefaultDatatypeSerializer(
          type, {field<&Prototype::getLower, &Prototype::setLower>(u"lower"),
                 field<&Prototype::getUpper, &Prototype::setUpper>(u"upper"),
                 field<&Prototype::isOrdered, &Prototype::setIsOrdered>(u"isOrdered"),
                 field<&Prototype::isUnique, &Prototype::setIsUnique>(u"isUnique"),
                 field<&Prototype::getName, &Prototype::setName>(u"name"),
                 field<&Prototype::getTypeName, &Prototype::setTypeName>(u"typeName")})
{}

ExtensionPrototypeDatatypeSerializer::~ExtensionPrototypeDatatypeSerializer() = default;
}  // namespace tarn::kiln::meta
