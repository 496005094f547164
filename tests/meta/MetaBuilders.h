/// \file
/// The builders of all classes of the metamodel, and the list of those that build something.
#pragma once
#include "tarnkiln/meta/ArgumentBuilder.h"
#include "tarnkiln/meta/AttributeBuilder.h"
#include "tarnkiln/meta/AttributeMapAttributeBuilder.h"
#include "tarnkiln/meta/AttributeMapBuilder.h"
#include "tarnkiln/meta/BooleanAttributeBuilder.h"
#include "tarnkiln/meta/ClassBuilder.h"
#include "tarnkiln/meta/DataTypeBuilder.h"
#include "tarnkiln/meta/DateTimeAttributeBuilder.h"
#include "tarnkiln/meta/DynamicExtensionsBuilder.h"
#include "tarnkiln/meta/EnumBuilder.h"
#include "tarnkiln/meta/EnumLiteralBuilder.h"
#include "tarnkiln/meta/ExtensionBuilder.h"
#include "tarnkiln/meta/IntegerAttributeBuilder.h"
#include "tarnkiln/meta/NamedElementBuilder.h"
#include "tarnkiln/meta/OperationBuilder.h"
#include "tarnkiln/meta/PackageBuilder.h"
#include "tarnkiln/meta/PrimitiveTypeBuilder.h"
#include "tarnkiln/meta/PropertyBuilder.h"
#include "tarnkiln/meta/RealAttributeBuilder.h"
#include "tarnkiln/meta/StringAttributeBuilder.h"
#include "tarnkiln/meta/StructuredTypeBuilder.h"
#include "tarnkiln/meta/TypeBuilder.h"
#include "tarnkiln/meta/TypedElementBuilder.h"
#include "tarnkiln/meta/UUIDAttributeBuilder.h"

#include <gtest/gtest.h>

namespace tarn::kiln::meta {

using ConcreteMetaClasses =
    ::testing::Types<Argument, AttributeMap, AttributeMapAttribute, BooleanAttribute, Class,
                     DataType, DateTimeAttribute, DynamicExtensions, Enum, EnumLiteral, Extension,
                     IntegerAttribute, NamedElement, Operation, Package, PrimitiveType, Property,
                     RealAttribute, StringAttribute, StructuredType, Type, TypedElement,
                     UUIDAttribute>;
}  // namespace tarn::kiln::meta
