/// \file
/// A value of a data type that has no C++ class.
///
///     ReflectiveDataType address(addressType);
///     address.setPropertyValue(city, Value(meta::StandardTypes::stringMeta, ustring(u"Bath")));
///     home->setPropertyValue(addressOfHome, Value::createReflectiveDataTypeValue(address), tag);
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/Property.h"

#include <boost/optional.hpp>

#include <unordered_map>

namespace tarn::kiln {

/// The fields of a structured value, each with its default until it is set.
///
/// A plain value: a copy has fields of its own. A default is computed when the field is first read,
/// and kept: a dynamic one, such as a random UUID, is another one in each object, but stays.
///
/// Danger: a required field of the object's own type is a value that never ends, which can be made
/// but not compared.
///
/// Threads: reading writes too. An object must not be used by two threads at once.
class TARNKILN_EXPORT ReflectiveDataType
{
public:
    /// \throws tarnkiln::messages::NoSuchType  (qualified name) if the type is empty or dead.
    explicit ReflectiveDataType(meta::DataType const& type);

    meta::DataType const& getDataType() const { return m_type; }

    /// The field; its default if it was not set, or if what was set has a wrong shape.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  (name of the property, qualified name of the
    /// data
    ///     type) if the property is empty, dead or of another type.
    /// \throws tarnkiln::messages::CannotUsePropertyWithoutType  (its name) if its type is empty or
    /// dead. \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the
    /// property's
    ///     type) if the property has many values and there are no collections of the type.
    Value getPropertyValue(meta::Property const& property) const;
    /// Sets the field. The shape of `value` does not matter here.
    ///
    /// \throws tarnkiln::messages::NoSuchProperty  as above.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the property's
    ///     type) if the value is of another type; an absent value suits an optional enumeration.
    void setPropertyValue(meta::Property const& property, Value const& value);
    /// What a field that was not set contains: a reflective value if the type of the property is
    /// a data type, else its default value, else its empty value. A field of many values is an
    /// empty unmanaged collection.
    Value getDefaultValue(meta::Property const& property) const;

    /// The value in the C++ class of the data type, with the fields that were set or read; none if
    /// there is no serializer for the type.
    boost::optional<Value> toNonReflectiveDataTypeValue() const;

    /// Negative, 0 or positive, by the fields in the order of their names.
    ///
    /// Absent values come first. Numbers, texts by code unit, UUIDs and points in time are ordered
    /// as such, with NaN behind all numbers and "not-a-date-time" before all times; literals by
    /// number, elements by UUID, collections by their entries.
    /// \throws tarnkiln::messages::CannotCastIncompatibleTypes  (qualified name of the other one's
    ///     data type) if the data types differ.
    int compareWith(ReflectiveDataType const& other) const;
    /// The same data type, and no field differs.
    bool operator==(ReflectiveDataType const& other) const;
    bool operator<(ReflectiveDataType const& other) const { return compareWith(other) < 0; }

private:
    void checkOwned(meta::Property const& property) const;

    meta::DataType m_type;
    /// Those that were set or read.
    mutable std::unordered_map<meta::Property, Value, std::hash<ModelElement>> m_fields;
};
}  // namespace tarn::kiln
