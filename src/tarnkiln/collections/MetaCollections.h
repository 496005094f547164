/// \file
/// The collections of the metamodel's own classes, compiled once.
///
/// Code that uses such a collection includes this instead of the header of the template.
#pragma once
#include "tarnkiln/collections/ElementMap.h"
#include "tarnkiln/collections/ElementMultimap.h"
#include "tarnkiln/collections/ElementSequence.h"
#include "tarnkiln/collections/UnorderedElementSet.h"
#include "tarnkiln/meta/Catalogue.h"

/// Calls `X(C)` for each handle class of the metamodel.
#define TARNKILN_FOR_EACH_META_CLASS(X)                                                            \
    X(meta::Argument)                                                                              \
    X(meta::Attribute)                                                                             \
    X(meta::AttributeMap)                                                                          \
    X(meta::AttributeMapAttribute)                                                                 \
    X(meta::BooleanAttribute)                                                                      \
    X(meta::Class)                                                                                 \
    X(meta::DataType)                                                                              \
    X(meta::DateTimeAttribute)                                                                     \
    X(meta::DynamicExtensions)                                                                     \
    X(meta::Enum)                                                                                  \
    X(meta::EnumLiteral)                                                                           \
    X(meta::Extension)                                                                             \
    X(meta::IntegerAttribute)                                                                      \
    X(meta::NamedElement)                                                                          \
    X(meta::Operation)                                                                             \
    X(meta::Package)                                                                               \
    X(meta::PrimitiveType)                                                                         \
    X(meta::Property)                                                                              \
    X(meta::RealAttribute)                                                                         \
    X(meta::StringAttribute)                                                                       \
    X(meta::StructuredType)                                                                        \
    X(meta::Type)                                                                                  \
    X(meta::TypedElement)                                                                          \
    X(meta::UUIDAttribute)

/// Calls `X(C)` for each handle class that an owner holds by name, one a name.
#define TARNKILN_FOR_EACH_NAMED_MEMBER(X)                                                          \
    X(meta::Attribute)                                                                             \
    X(meta::EnumLiteral)                                                                           \
    X(meta::Extension)                                                                             \
    X(meta::Package)                                                                               \
    X(meta::Property)                                                                              \
    X(meta::Type)

namespace tarn::kiln {

#define TARNKILN_DECLARE(T)                                                                        \
    extern template class ElementSequence<T>;                                                      \
    extern template class UnorderedElementSet<T>;
TARNKILN_FOR_EACH_META_CLASS(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE

#define TARNKILN_DECLARE(T) extern template class TARNKILN_EXPORT ElementMap<ustring, T>;
TARNKILN_FOR_EACH_NAMED_MEMBER(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE

extern template class TARNKILN_EXPORT ElementMultimap<ustring, meta::Operation>;
extern template class TARNKILN_EXPORT ElementMap<unsigned long, meta::DynamicExtensions>;
}  // namespace tarn::kiln
