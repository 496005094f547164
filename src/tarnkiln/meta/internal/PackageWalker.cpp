#include "tarnkiln/meta/internal/PackageWalker.h"

#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/AbstractMetaPackage.h"
#include "tarnkiln/meta/AbstractMethodInvoker.h"
#include "tarnkiln/meta/ArgumentImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PrimitiveTypeImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/SchemaBase.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

namespace tarn::kiln::internal {
namespace {

using support::PropertyRow;
using support::TypeTable;

/// The flags that make `createProperty` set the bounds of the row, or come closest to them.
ValueFlags shapeOf(PropertyRow const& row)
{
    if (row.upper > 1)
        return row.flags & support::ORDERED ? ValueFlags::Sequence : ValueFlags::Set;
    return row.lower == 1 ? ValueFlags::Single : ValueFlags::OptionalSingle;
}

ustring uriOf(support::PackageRow const& row)
{
    ustring const uri = row.uri;
    return uri.find(u"://") == ustring::npos ? meta::SchemaBase + uri : uri;
}

Model const& registryModel()
{
    return meta::MetaRegistry::getInstance().getModel();
}

/// A new element that bears the row's name and UUID.
template <class Handle> Handle createNamed(auto const& row)
{
    Handle const created = Handle::create(registryModel(), boost::lexical_cast<UUID>(row.uuid));
    created->setName(row.name);
    return created;
}

meta::Type requireType(char16_t const* name)
{
    meta::Type const type = meta::MetaRegistry::getInstance().getType(name);
    if (!type)
        reportException(tarnkiln::messages::NoSuchType(name));
    return type;
}
}  // namespace

PackageWalker::PackageWalker(meta::AbstractMetaPackage& package, support::PackageRows const& rows,
                             support::PackageElements& elements)
    : m_package(package),
      m_rows(rows),
      m_elements(elements)
{}

// ---------------------------------------------------------------------------- creation

void PackageWalker::createElements()
{
    createPackages();
    for (std::size_t i = 0; i < m_rows.classes.size(); ++i)
    {
        support::StructuredTypeRow const& row = m_rows.classes[i];
        m_elements.classes[i] =
            m_package.createClass(row.name, row.vobjName, row.isAbstract, row.uuid);
        setDisplay(row, m_elements.classes[i]);
        createMembers(row);
    }
    for (std::size_t i = 0; i < m_rows.dataTypes.size(); ++i)
    {
        support::StructuredTypeRow const& row = m_rows.dataTypes[i];
        m_elements.dataTypes[i] = m_package.createDataType(row.name, row.vobjName, row.uuid);
        setDisplay(row, m_elements.dataTypes[i]);
        createMembers(row);
    }
    for (char16_t const* const name : m_rows.requiredTypes)
    {
        if (!meta::MetaRegistry::getInstance().getPrimitiveType(name))
            reportException(tarnkiln::messages::NoSuchType(name));
    }
    for (std::size_t i = 0; i < m_rows.enumerations.size(); ++i)
        createEnum(i);
}

void PackageWalker::createPackages()
{
    for (std::size_t i = 0; i < m_rows.packages.size(); ++i)
    {
        support::PackageRow const& row = m_rows.packages[i];
        if (row.uuid)
        {
            m_elements.packages[i] = createNamed<meta::Package>(row);
            m_elements.packages[i]->setUri(uriOf(row));
        }
        else
        {
            m_elements.packages[i] = m_package.createPackage(row.name, uriOf(row));
        }
        if (row.defaultVobjCategory)
            m_package.setDefaultVobjCategory(m_elements.packages[i], row.defaultVobjCategory);
        createPrimitiveTypes(i);
    }
}

void PackageWalker::createPrimitiveTypes(std::size_t package)
{
    for (std::size_t i = 0; i < m_rows.primitiveTypes.size(); ++i)
    {
        if (m_rows.primitiveTypes[i].package == package)
            m_elements.primitiveTypes[i] =
                createNamed<meta::PrimitiveType>(m_rows.primitiveTypes[i]);
    }
}

void PackageWalker::setDisplay(support::StructuredTypeRow const& row,
                               meta::StructuredType const& type)
{
    type->setIsVobjHidden(row.isVobjHidden);
    m_package.setVobjCompactDisplay(type, row.vobjCompactDisplay);
    for (std::size_t i = 0; i < row.vobjDispCategories.count; ++i)
        type->getVobjDispCategories().push_back(
            m_rows.displayGroups[row.vobjDispCategories.first + i]);
}

void PackageWalker::createMembers(support::StructuredTypeRow const& row)
{
    for (std::size_t i = 0; i < row.properties.count; ++i)
        createProperty(row.properties.first + i);
    for (std::size_t i = 0; i < row.operations.count; ++i)
        createOperation(row.operations.first + i);
}

void PackageWalker::createProperty(std::size_t number)
{
    PropertyRow const& row = m_rows.properties[number];
    auto const is = [&](support::PropertyFlag flag) { return (row.flags & flag) != 0; };
    meta::Property const created =
        m_package.createProperty(row.name, shapeOf(row), is(support::COMPOSITE), row.uuid);
    m_elements.properties[number] = created;

    created->setLower(row.lower);
    created->setUpper(row.upper);
    created->setIsOrdered(is(support::ORDERED));
    created->setIsUnique(is(support::UNIQUE));
    created->setIsDerived(is(support::DERIVED));
    created->setIsReadOnly(is(support::READ_ONLY));
    created->setIsTransient(is(support::TRANSIENT));
    created->setIsSparse(is(support::SPARSE));
    created->setIsPublicAccessor(!is(support::NO_PUBLIC_ACCESSOR));
    created->setIsPublicMutator(!is(support::NO_PUBLIC_MUTATOR));
    created->setIsSetOnce(is(support::SET_ONCE));
    created->setCustomQualification(is(support::CUSTOM_QUALIFICATION));
    created->setIsQueryIndex(is(support::QUERY_INDEX));
    created->setIsVobjHidden(is(support::VOBJ_HIDDEN));
    if (is(support::VOBJ_DISP_SKIP_EMPTY))
        m_package.setVobjDispSkipEmpty(created);
    if (row.vobjDispCategory)
        m_package.setVobjDispCategory(created, row.vobjDispCategory);
    if (row.defaultText)
        created->setDefaultValue(ustring(row.defaultText));
    if (row.index != PropertyRow::NO_INDEX)
        m_package.setPropertyIndex(created, row.index);
}

void PackageWalker::createOperation(std::size_t number)
{
    support::OperationRow const& row = m_rows.operations[number];
    auto const is = [&](support::OperationFlag flag) { return (row.flags & flag) != 0; };
    meta::Operation const created = createNamed<meta::Operation>(row);
    m_elements.operations[number] = created;

    created->setIsAbstract(is(support::ABSTRACT));
    created->setIsStatic(is(support::STATIC));
    created->setIsPublic(!is(support::NOT_PUBLIC));
    created->setIsEvent(is(support::EVENT));
    for (std::size_t i = 0; i < row.arguments.count; ++i)
    {
        support::ArgumentRow const& argument = m_rows.arguments[row.arguments.first + i];
        meta::Argument const made = createNamed<meta::Argument>(argument);
        made->setIsInput(argument.isInput);
        m_elements.arguments[row.arguments.first + i] = made;
    }
}

void PackageWalker::createEnum(std::size_t number)
{
    support::EnumRow const& row = m_rows.enumerations[number];
    m_elements.enumerations[number] = m_package.createEnum(row.name, row.uuid);
    m_elements.enumerations[number]->setIsVobjHidden(row.isVobjHidden);
    for (std::size_t i = 0; i < row.literals.count; ++i)
    {
        support::LiteralRow const& literal = m_rows.literals[row.literals.first + i];
        meta::EnumLiteral const created =
            m_package.createEnumLiteral(literal.name, literal.value, literal.uuid);
        if (literal.publicIdentifier)
            created->setPublicIdentifier(ustring(literal.publicIdentifier));
        m_elements.literals[row.literals.first + i] = created;
    }
}

// ---------------------------------------------------------------------------- connection

void PackageWalker::connectAndRegister()
{
    meta::MetaRegistry& registry = meta::MetaRegistry::getInstance();
    for (std::size_t i = 1; i < m_rows.packages.size(); ++i)
        m_elements.packages[i]->setParentPackage(m_elements.packages[m_rows.packages[i].parent]);
    for (std::size_t i = 0; i < m_rows.primitiveTypes.size(); ++i)
        connectPrimitiveType(i);
    for (std::size_t i = 0; i < m_rows.classes.size(); ++i)
    {
        support::StructuredTypeRow const& row = m_rows.classes[i];
        meta::Class const& type = m_elements.classes[i];
        type->setOwningPackage(m_elements.packages[row.package]);
        type->setSuperclass(meta::Class::cast(typeOf(row.superclass)));
        connectMembers(row, type);
        registry.registerType(type, row.collection, row.builder);
    }
    for (std::size_t i = 0; i < m_rows.dataTypes.size(); ++i)
    {
        support::StructuredTypeRow const& row = m_rows.dataTypes[i];
        meta::DataType const& type = m_elements.dataTypes[i];
        type->setOwningPackage(m_elements.packages[row.package]);
        connectMembers(row, type);
        registry.registerType(type, row.collection, row.builder);
        if (row.serializers)
            row.serializers(type);
    }
    for (std::size_t i = 0; i < m_rows.enumerations.size(); ++i)
        connectEnum(i);
}

void PackageWalker::connectPrimitiveType(std::size_t number)
{
    support::PrimitiveTypeRow const& row = m_rows.primitiveTypes[number];
    meta::PrimitiveType const& type = m_elements.primitiveTypes[number];
    type->setOwningPackage(m_elements.packages[row.package]);
    meta::MetaRegistry::getInstance().registerType(type, row.collection, /*builder=*/nullptr);
    if (row.serializers)
        row.serializers(type);
}

void PackageWalker::connectMembers(support::StructuredTypeRow const& row,
                                   meta::StructuredType const& owner)
{
    for (std::size_t i = 0; i < row.properties.count; ++i)
        connectProperty(row.properties.first + i, owner);
    for (std::size_t i = 0; i < row.operations.count; ++i)
        connectOperation(row.operations.first + i, owner);
}

void PackageWalker::connectProperty(std::size_t number, meta::StructuredType const& owner)
{
    PropertyRow const& row = m_rows.properties[number];
    meta::Property const& property = m_elements.properties[number];
    property->setOwningType(owner);
    property->setType(typeOf(row.type));
    property->setOpposite(propertyOf(row.opposite));
    property->setQualifiedBy(propertyOf(row.qualifiedBy));
    property->setIsQualificationUnique(!(row.flags & support::QUALIFICATION_NOT_UNIQUE));
}

void PackageWalker::connectOperation(std::size_t number, meta::StructuredType const& owner)
{
    support::OperationRow const& row = m_rows.operations[number];
    meta::Operation const& operation = m_elements.operations[number];
    operation->setOwningType(owner);
    for (std::size_t i = 0; i < row.arguments.count; ++i)
    {
        support::ArgumentRow const& argument = m_rows.arguments[row.arguments.first + i];
        meta::Argument const& made = m_elements.arguments[row.arguments.first + i];
        made->setType(typeOf(argument.type));
        made->setOperation(operation);
        made->setLower(argument.lower);
        made->setUpper(argument.upper);
        made->setIsOrdered(argument.isOrdered);
    }
    operation->setType(typeOf(row.type));
    operation->setLower(row.lower);
    operation->setUpper(row.upper);
    operation->setIsOrdered(row.isOrdered);
    if (row.invoker)
        m_package.setInvoker(operation, row.invoker(operation));
}

void PackageWalker::connectEnum(std::size_t number)
{
    support::EnumRow const& row = m_rows.enumerations[number];
    meta::Enum const& type = m_elements.enumerations[number];
    type->setOwningPackage(m_elements.packages[row.package]);
    type->setUnderlyingType(meta::PrimitiveType::cast(typeOf(row.underlyingType)));
    for (std::size_t i = 0; i < row.literals.count; ++i)
        m_elements.literals[row.literals.first + i]->setParentEnum(type);
    meta::MetaRegistry::getInstance().registerType(type, row.collection, /*builder=*/nullptr);
    if (row.serializers)
        row.serializers(type);
}

meta::Type PackageWalker::typeOf(support::TypeReference const& reference) const
{
    switch (reference.table)
    {
    case TypeTable::None:
        return {};
    case TypeTable::Named:
        return requireType(reference.name);
    case TypeTable::Classes:
        return m_elements.classes[reference.row];
    case TypeTable::DataTypes:
        return m_elements.dataTypes[reference.row];
    case TypeTable::Enumerations:
        return m_elements.enumerations[reference.row];
    case TypeTable::PrimitiveTypes:
        return m_elements.primitiveTypes[reference.row];
    }
    return {};
}

meta::Property PackageWalker::propertyOf(support::PropertyReference const& reference) const
{
    if (reference.row != support::PropertyReference::NONE)
        return m_elements.properties[reference.row];
    if (!reference.type)
        return {};
    meta::StructuredType const owner = meta::StructuredType::cast(requireType(reference.type));
    meta::Property const found =
        owner ? owner->getPropertyByName(reference.name) : meta::Property();
    if (!found)
        reportException(tarnkiln::messages::NoSuchProperty(reference.name, reference.type));
    return found;
}
}  // namespace tarn::kiln::internal
