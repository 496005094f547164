/// \file
/// A metamodel as constant data: what generated code says about its packages, types, properties and
/// operations, and what `RowPackage` builds from it.
///
/// Each table is an array; a row is known by its number in its array. A row that refers to a type
/// or a property of the same metamodel gives the number, and one that refers elsewhere gives names,
/// which the registry resolves. Nothing here assumes the library's own metamodel: a client's tables
/// have the same form.
///
///     constexpr support::PropertyRow properties[] = {
///         {.name = u"title", .index = 1, .type = {u"String"}, .lower = 1, .upper = 1,
///          .flags = support::ORDERED | support::UNIQUE, .uuid = "5b8a5eae-..."},
///     };
#pragma once
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/MetaRegistry.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>

namespace tarn::kiln::support {

/// The upper bound that stands for any number of values.
inline constexpr std::uint32_t UNBOUNDED = 0xFFFFFFFF;

/// Rows that follow each other in another table.
struct RowRange
{
    std::size_t first = 0;
    std::size_t count = 0;
};

/// The tables that hold types.
enum class TypeTable : std::uint8_t
{
    None,   ///< No type.
    Named,  ///< A type of the registry, by its qualified name.
    Classes,
    DataTypes,
    Enumerations,
    PrimitiveTypes
};

/// A type: none, a row of this metamodel, or a type that the registry knows by name.
struct TypeReference
{
    constexpr TypeReference() = default;
    constexpr TypeReference(char16_t const* qualifiedName)
        : table(TypeTable::Named),
          name(qualifiedName)
    {}
    constexpr TypeReference(TypeTable inTable, std::size_t number) : table(inTable), row(number) {}

    TypeTable table = TypeTable::None;
    char16_t const* name = nullptr;
    std::size_t row = 0;
};

/// A property: none, a row of this metamodel, or one of a type that the registry knows by name.
struct PropertyReference
{
    static constexpr std::size_t NONE = ~std::size_t{0};

    constexpr PropertyReference() = default;
    constexpr PropertyReference(std::size_t number) : row(number) {}
    constexpr PropertyReference(char16_t const* qualifiedName, char16_t const* property)
        : type(qualifiedName),
          name(property)
    {}

    std::size_t row = NONE;
    char16_t const* type = nullptr;
    char16_t const* name = nullptr;
};

/// What a property is; a bit is set where it differs from a new `Property`.
enum PropertyFlag : unsigned
{
    ORDERED = 1u << 0,
    UNIQUE = 1u << 1,
    COMPOSITE = 1u << 2,
    DERIVED = 1u << 3,
    READ_ONLY = 1u << 4,
    TRANSIENT = 1u << 5,
    SPARSE = 1u << 6,
    NO_PUBLIC_ACCESSOR = 1u << 7,
    NO_PUBLIC_MUTATOR = 1u << 8,
    QUALIFICATION_NOT_UNIQUE = 1u << 9,
    SET_ONCE = 1u << 10,
    CUSTOM_QUALIFICATION = 1u << 11,
    QUERY_INDEX = 1u << 12,
    VOBJ_HIDDEN = 1u << 13,
    VOBJ_DISP_SKIP_EMPTY = 1u << 14
};

/// What an operation is; a bit is set where it differs from a new `Operation`.
enum OperationFlag : unsigned
{
    ABSTRACT = 1u << 0,
    STATIC = 1u << 1,
    NOT_PUBLIC = 1u << 2,
    EVENT = 1u << 3
};

/// Makes what calls of an operation by reflection run.
using InvokerMaker =
    std::unique_ptr<meta::AbstractMethodInvoker> (*)(meta::Operation const& operation);
/// Registers how values of a type are written and read.
using SerializerInstaller = void (*)(meta::Type const& type);

/// A package; the first one is the root, and a parent comes before its children.
struct PackageRow
{
    char16_t const* name;
    std::size_t parent = 0;  ///< The row of the package around it; the root names itself.
    char16_t const* uri;     ///< Behind `SchemaBase`, unless it has a scheme ("a://") itself.
    char const* defaultVobjCategory = nullptr;
    char const* uuid = nullptr;  ///< Null: a fresh one. The root must have one.
};

/// A primitive type of the metamodel's own; made directly after its package.
struct PrimitiveTypeRow
{
    char16_t const* name;
    std::size_t package;
    meta::MetaRegistry::CollectionInstantiator collection = nullptr;
    SerializerInstaller serializers = nullptr;
    char const* uuid;
};

struct PropertyRow
{
    static constexpr int NO_INDEX = -1;

    char16_t const* name;
    int index = NO_INDEX;  ///< The slot, from 1; none for derived ones and those of data types.
    TypeReference type;
    std::uint32_t lower;
    std::uint32_t upper;
    unsigned flags = 0;  ///< Of `PropertyFlag`.
    PropertyReference opposite = {};
    PropertyReference qualifiedBy = {};
    char16_t const* defaultText = nullptr;
    char const* vobjDispCategory = nullptr;
    char const* uuid;
};

struct ArgumentRow
{
    char16_t const* name;
    TypeReference type;
    std::uint32_t lower;
    std::uint32_t upper;
    bool isOrdered = false;
    bool isInput = true;
    char const* uuid;
};

struct OperationRow
{
    char16_t const* name;
    TypeReference type = {};  ///< Of the result; none, if there is no result.
    std::uint32_t lower = 0;
    std::uint32_t upper = 0;
    bool isOrdered = false;
    unsigned flags = 0;  ///< Of `OperationFlag`.
    RowRange arguments = {};
    InvokerMaker invoker = nullptr;
    char const* uuid;
};

/// A class or a data type.
struct StructuredTypeRow
{
    char16_t const* name;
    char const* vobjName;
    std::size_t package;
    TypeReference superclass = {};  ///< Of a class.
    bool isAbstract = false;        ///< Of a class.
    bool isVobjHidden = false;
    bool vobjCompactDisplay = false;
    RowRange vobjDispCategories = {};  ///< Among the display groups.
    RowRange properties = {};
    RowRange operations = {};
    meta::MetaRegistry::CollectionInstantiator collection = nullptr;
    meta::MetaRegistry::BuilderInstantiator builder = nullptr;
    SerializerInstaller serializers = nullptr;  ///< Of a data type.
    char const* uuid;
};

struct LiteralRow
{
    char16_t const* name;
    int value;
    char16_t const* publicIdentifier = nullptr;
    char const* uuid;
};

struct EnumRow
{
    char16_t const* name;
    std::size_t package;
    TypeReference underlyingType;
    bool isVobjHidden = false;
    RowRange literals;
    meta::MetaRegistry::CollectionInstantiator collection = nullptr;
    SerializerInstaller serializers = nullptr;
    char const* uuid;
};

/// All tables of one metamodel. Elements are made in the order of the rows.
struct PackageRows
{
    std::span<PackageRow const> packages = {};
    std::span<PrimitiveTypeRow const> primitiveTypes = {};
    std::span<StructuredTypeRow const> classes = {};
    std::span<StructuredTypeRow const> dataTypes = {};
    std::span<PropertyRow const> properties = {};
    std::span<OperationRow const> operations = {};
    std::span<ArgumentRow const> arguments = {};
    std::span<EnumRow const> enumerations = {};
    std::span<LiteralRow const> literals = {};
    std::span<char const* const> displayGroups = {};
    /// Primitive types of the registry without which the metamodel can not be built.
    std::span<char16_t const* const> requiredTypes = {};
    /// Build the metamodels whose types the rows refer to by name.
    std::span<void (*const)()> imports = {};
};
}  // namespace tarn::kiln::support
