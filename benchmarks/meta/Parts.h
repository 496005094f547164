/// \file
/// The same elements three times: of a generated class by its getters and setters, of that class
/// by reflection, and of a class that exists as data only.
#pragma once
#include "parts/Part.h"
#include "parts/PartImpl.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PackageDefinition.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <string>

namespace benchkit {

using namespace tarn::kiln;
using meta::StandardTypes;

/// Elements of the generated class, by generated code.
class GeneratedParts
{
public:
    using Part = parts::Part;

    Part make(Model const& model) const { return Part::create(model); }
    int width(Part const& part) const { return part->getWidth(); }
    void setWidth(Part const& part, int width) const { part->setWidth(width); }
    Part left(Part const& part) const { return part->getLeft(); }
    void setLeft(Part const& part, Part const& other) const { part->setLeft(other); }
    void addChild(Part const& part, Part const& child) const
    {
        part->getChildren().push_back(child);
    }
    void removeChild(Part const& part, Part const& child) const
    {
        part->getChildren().remove(child);
    }
};

/// Elements of a class that has the properties of `Part`, by reflection alone.
class ReflectedParts
{
public:
    using Part = ModelElement;

    explicit ReflectedParts(meta::Class const& metaClass)
        : m_width(metaClass->getPropertyByName(u"width")),
          m_left(metaClass->getPropertyByName(u"left")),
          m_children(metaClass->getPropertyByName(u"children"))
    {}

    int width(Part const& part) const { return read(part, m_width).getValue<int>(); }
    void setWidth(Part const& part, int width) const
    {
        write(part, m_width, Value(StandardTypes::integerMeta, width));
    }
    Part left(Part const& part) const { return read(part, m_left).getValue<ModelElement>(); }
    void setLeft(Part const& part, Part const& other) const
    {
        write(part, m_left, Value(m_left->getType(), other));
    }
    void addChild(Part const& part, Part const& child) const { children(part).genericAdd(child); }
    void removeChild(Part const& part, Part const& child) const
    {
        children(part).genericRemove(child);
    }

private:
    static Value read(Part const& part, meta::Property const& property)
    {
        return part->getPropertyValue(property, ModelElement::Impl::PUBLIC_ACCESS);
    }
    static void write(Part const& part, meta::Property const& property, Value const& value)
    {
        part->setPropertyValue(property, value, ModelElement::Impl::PUBLIC_ACCESS);
    }
    GenericCollectionInterface& children(Part const& part) const
    {
        return *read(part, m_children).getValue<ReferenceCollection&>().getGenericInterface();
    }

    meta::Property m_width, m_left, m_children;
};

/// Elements of the generated class, by reflection.
class GeneratedByReflection : public ReflectedParts
{
public:
    GeneratedByReflection() : ReflectedParts(parts::Part::metaClass()) {}
    Part make(Model const& model) const { return parts::Part::create(model); }
};

/// Elements of a class like `Part` that has no code.
class RunTimeParts : public ReflectedParts
{
public:
    RunTimeParts() : ReflectedParts(metaClass()) {}
    Part make(Model const& model) const
    {
        return ModelElement::createReflective(model, metaClass());
    }

private:
    static meta::Class const& metaClass()
    {
        static meta::Class const part = define();
        return part;
    }
    static meta::Class define()
    {
        meta::PackageDefinition package(u"partsAtRunTime", u"http://example.org/parts");
        meta::ClassDefinition part = package.defineClass(u"Part");
        part.attribute(u"name", StandardTypes::stringMeta);
        part.attribute(u"width", StandardTypes::integerMeta);
        part.attribute(u"height", StandardTypes::integerMeta);
        part.attribute(u"price", StandardTypes::realMeta).optional();
        part.reference(u"left", part);
        part.reference(u"right", part);
        part.contents(u"children", part).sequence().unique().opposite(u"parent");
        package.finish();
        return part;
    }
};
}  // namespace benchkit
