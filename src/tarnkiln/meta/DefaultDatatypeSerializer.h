/// \file
/// The base of the serializers of data types that have a C++ class.
///
///     IsbnDatatypeSerializer::IsbnDatatypeSerializer(DataType const& type)
///         : DefaultDatatypeSerializer(type, {field<&Isbn::getGroup, &Isbn::setGroup>(u"group"),
///                                            field<&Isbn::getTitle, &Isbn::setTitle>(u"title")})
///     {}
#pragma once
#include "tarnkiln/kernel/Messages.h"
#include "tarnkiln/kernel/reportException.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/support/CarriedValue.h"
#include "tarnkiln/support/DatatypeField.h"

#include <initializer_list>
#include <vector>

namespace tarn::kiln::meta {

/// Leaves nothing to a derived class but the list of the fields.
///
/// \tparam T  what the values of the data type are carried as; `T()` is the default.
template <class T> class DefaultDatatypeSerializer : public DatatypeSerializer
{
public:
    // DatatypeSerializer
    Value getPropertyValue(Value const& value, Property const& property) const override;
    /// A reflective value is taken for a field of a data type too.
    Value setPropertyValue(Value const& value, Property const& property,
                           Value const& field) const override;
    Value createEmptyOptionalValue() const override { return Carried::makeAbsent(m_type); }
    Value createDefaultValue() const override { return Carried::make(m_type, T()); }
    Value combineAsUnmanagedSequenceValue(Type const& type,
                                          std::vector<Value> const& values) const override
    {
        return Carried::template combine<ValueFlags::Sequence>(type, values, m_type);
    }
    /// In the order of `operator<`.
    Value combineAsUnmanagedSetValue(Type const& type,
                                     std::vector<Value> const& values) const override
    {
        return Carried::template combine<ValueFlags::Set>(type, values, m_type);
    }

protected:
    struct Field
    {
        char16_t const* name;
        Value (*read)(T const& object, Property const& property);
        void (*write)(T& object, Property const& property, Value const& field);
    };

    /// \param type    must have the properties that the fields are named after.
    DefaultDatatypeSerializer(DataType const& type, std::initializer_list<Field> fields);

    template <auto GETTER, auto SETTER> static Field field(char16_t const* name)
    {
        using Access = support::DatatypeField<T, GETTER, SETTER>;
        return {name, Access::read, Access::write};
    }

private:
    using Carried = support::CarriedValue<T>;

    struct Row
    {
        Property property;
        Field field;
    };

    Field const& fieldOf(Property const& property) const;

    DataType const m_type;
    std::vector<Row> m_rows;
};

template <class T>
DefaultDatatypeSerializer<T>::DefaultDatatypeSerializer(DataType const& type,
                                                        std::initializer_list<Field> fields)
    : m_type(type)
{
    for (Field const& field : fields)
        m_rows.push_back({type->getOwnedAttributes().find(field.name), field});
}

template <class T>
Value DefaultDatatypeSerializer<T>::getPropertyValue(Value const& value,
                                                     Property const& property) const
{
    T const object = Carried::read(value, m_type);
    return fieldOf(property).read(object, property);
}

template <class T>
Value DefaultDatatypeSerializer<T>::setPropertyValue(Value const& value, Property const& property,
                                                     Value const& field) const
{
    T object = Carried::read(value, m_type);
    fieldOf(property).write(object, property, field);
    return Carried::make(m_type, object);
}

template <class T>
typename DefaultDatatypeSerializer<T>::Field const&
DefaultDatatypeSerializer<T>::fieldOf(Property const& property) const
{
    for (Row const& row : m_rows)
    {
        if (row.property == property && property)
            return row.field;
    }
    reportException(tarnkiln::messages::NoSuchProperty(
        property.getImpl() ? property->getName() : ustring(), m_type->getQualifiedName()));
}
}  // namespace tarn::kiln::meta
