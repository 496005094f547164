/// \file
/// What kind of type a type is. Asks the object itself, so that it works before its own metamodel
/// is there.
#pragma once
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/Type.h"

namespace tarn::kiln::internal {

enum class TypeKind
{
    Nothing,
    Primitive,
    Class,
    Enum,
    DataType,
    Other  ///< No metaclass of the catalogue makes such types.
};

/// `Nothing` if `type` is empty; a dead class is one too.
TypeKind kindOf(meta::Type const& type);
/// Null if `type` is no class.
meta::Class::Impl* classImpl(meta::Type const& type);
inline bool isEnumType(meta::Type const& type)
{
    return kindOf(type) == TypeKind::Enum;
}
}  // namespace tarn::kiln::internal
