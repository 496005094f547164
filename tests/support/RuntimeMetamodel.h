/// \file
/// Classes that exist only as data, and elements of them, for tests.
///
///     RuntimeMetamodel metamodel;
///     meta::Class const shelf = metamodel.makeClass(u"Shelf");
///     meta::Class const book = metamodel.makeClass(u"Book");
///     meta::Property const books = metamodel.property(shelf, u"books", book).many().ordered();
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <boost/optional.hpp>

#include <algorithm>
#include <optional>

namespace testkit {

using namespace tarn::kiln;
using meta::StandardTypes;

/// A property that is being described; is the property.
class PropertySketch
{
public:
    explicit PropertySketch(meta::Property const& property) : m_property(property) {}

    PropertySketch& required() { return with(&meta::Property::Impl::setLower, 1u); }
    PropertySketch& many() { return with(&meta::Property::Impl::setUpper, 0xFFFFFFFFu); }
    PropertySketch& ordered() { return with(&meta::Property::Impl::setIsOrdered, true); }
    PropertySketch& unique() { return with(&meta::Property::Impl::setIsUnique, true); }
    PropertySketch& composite() { return with(&meta::Property::Impl::setIsComposite, true); }
    PropertySketch& derived() { return with(&meta::Property::Impl::setIsDerived, true).at(0); }
    PropertySketch& readOnly() { return with(&meta::Property::Impl::setIsReadOnly, true); }
    PropertySketch& setOnce() { return with(&meta::Property::Impl::setIsSetOnce, true); }
    PropertySketch& notReadable()
    {
        return with(&meta::Property::Impl::setIsPublicAccessor, false);
    }
    PropertySketch& notWritable() { return with(&meta::Property::Impl::setIsPublicMutator, false); }
    PropertySketch& at(int index) { return with(&meta::Property::Impl::setPropertyIndex, index); }
    PropertySketch& byDefault(ustring const& text)
    {
        return with(&meta::Property::Impl::setDefaultValue, boost::optional<ustring>(text));
    }
    /// A map, many-valued.
    PropertySketch& keyedBy(meta::Property const& qualifier)
    {
        m_property->setQualifiedBy(qualifier);
        return many();
    }
    /// A multimap, many-valued.
    PropertySketch& groupedBy(meta::Property const& qualifier)
    {
        m_property->setIsQualificationUnique(false);
        return keyedBy(qualifier);
    }
    PropertySketch& opposite(meta::Property const& other)
    {
        m_property->setOpposite(other);
        other->setOpposite(m_property);
        return *this;
    }

    operator meta::Property() const { return m_property; }

private:
    template <class Argument, class Given>
    PropertySketch& with(void (meta::Property::Impl::*setter)(Argument), Given const& given)
    {
        (m_property.getImpl()->*setter)(given);
        return *this;
    }
    template <class Argument, class Given>
    PropertySketch& with(void (meta::TypedElement::Impl::*setter)(Argument), Given const& given)
    {
        (m_property.getImpl()->*setter)(given);
        return *this;
    }

    meta::Property m_property;
};

/// A metamodel in a model of its own, under a root package "rt".
class RuntimeMetamodel
{
public:
    RuntimeMetamodel()
    {
        StandardTypes::ensureInitialized();
        package = meta::Package::create(model);
        package->setName(u"rt");
    }
    RuntimeMetamodel(RuntimeMetamodel const&) = delete;
    RuntimeMetamodel& operator=(RuntimeMetamodel const&) = delete;

    meta::Class makeClass(ustring const& name,
                          meta::Class const& superclass = ModelElement::metaClass())
    {
        meta::Class const made = meta::Class::create(model);
        made->setName(name);
        made->setSuperclass(superclass);
        made->setOwningPackage(package);
        return made;
    }
    /// Optional and single, with the next index of the class.
    PropertySketch property(meta::Class const& owner, ustring const& name, meta::Type const& type)
    {
        meta::Property const made = meta::Property::create(model);
        made->setName(name);
        made->setUpper(1);
        made->setPropertyIndex(highestIndex(owner) + 1);
        made->setType(type);
        made->setOwningType(owner);
        return PropertySketch(made);
    }
    meta::DataType makeDataType(ustring const& name)
    {
        meta::DataType const made = meta::DataType::create(model);
        made->setName(name);
        made->setOwningPackage(package);
        return made;
    }
    /// A field of a data type, optional and single.
    PropertySketch field(meta::DataType const& owner, ustring const& name, meta::Type const& type)
    {
        meta::Property const made = meta::Property::create(model);
        made->setName(name);
        made->setUpper(1);
        made->setType(type);
        made->setOwningType(owner);
        return PropertySketch(made);
    }
    /// Numbered from 0 in the order given.
    meta::Enum makeEnum(ustring const& name, std::vector<ustring> const& literals)
    {
        meta::Enum const made = meta::Enum::create(model);
        made->setName(name);
        made->setOwningPackage(package);
        int number = 0;
        for (ustring const& text : literals)
        {
            meta::EnumLiteral const literal = meta::EnumLiteral::create(model);
            literal->setName(text);
            literal->setValue(number++);
            literal->setParentEnum(made);
        }
        return made;
    }

    static int highestIndex(meta::Class const& owner)
    {
        int highest = 0;
        for (meta::Class at = owner; at; at = at->getSuperclass())
        {
            for (auto const& [name, property] : at->getOwnedAttributes())
                highest = std::max(highest, property->getPropertyIndex());
        }
        return highest;
    }

    Model const model = Model::create(ModelConstellation());
    meta::Package package;
};

/// \name Reading and writing by reflection, with all rights unless a tag is given
/// @{
inline Value
valueOf(ModelElement const& element, meta::Property const& property,
        ModelElement::Impl::ReflectionPrivateTag const& tag = ModelElement::Impl::PRIVILEGED_ACCESS)
{
    return element->getPropertyValue(property, tag);
}
template <class T> T get(ModelElement const& element, meta::Property const& property)
{
    return valueOf(element, property).getValue<T>();
}
/// As `std::optional`, which tests can print.
template <class T>
std::optional<T> getOptional(ModelElement const& element, meta::Property const& property)
{
    auto const value = get<boost::optional<T>>(element, property);
    return value ? std::optional<T>(*value) : std::nullopt;
}
inline ModelElement targetOf(ModelElement const& element, meta::Property const& property)
{
    return get<ModelElement>(element, property);
}
inline ReferenceCollection& referencesOf(ModelElement const& element,
                                         meta::Property const& property)
{
    return get<ReferenceCollection&>(element, property);
}
inline AbstractPrimitiveCollection& valuesOf(ModelElement const& element,
                                             meta::Property const& property)
{
    return get<AbstractPrimitiveCollection&>(element, property);
}
inline bool has(ModelElement const& element, meta::Property const& property)
{
    return element->hasPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS);
}
inline void setValue(ModelElement const& element, meta::Property const& property,
                     Value const& value)
{
    element->setPropertyValue(property, value, ModelElement::Impl::PUBLIC_ACCESS);
}
/// A plain payload or an element, as a value of the property's type.
template <class T>
void set(ModelElement const& element, meta::Property const& property, T const& payload)
{
    setValue(element, property, Value(property->getType(), payload));
}
inline void set(ModelElement const& element, meta::Property const& property, char16_t const* text)
{
    set(element, property, ustring(text));
}
inline void clear(ModelElement const& element, meta::Property const& property)
{
    setValue(element, property, Value::createEmptyValue(property));
}
/// @}
}  // namespace testkit
