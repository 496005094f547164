/// \file
/// A model like the registry's, for metamodel elements of a test's own.
#pragma once
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/PackageImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"

#include <gmock/gmock.h>

namespace tarn::kiln::meta {

/// Makes named elements, each in the place given.
class MetamodelSketch : public ::testing::Test
{
protected:
    Package package(ustring const& name, Package const& parent = {})
    {
        Package const made = named<Package>(name);
        made->setParentPackage(parent);
        return made;
    }
    Class cls(ustring const& name, Class const& superclass = {}, Package const& owner = {})
    {
        Class const made = named<Class>(name);
        made->setSuperclass(superclass);
        made->setOwningPackage(owner);
        return made;
    }
    Property property(ustring const& name, StructuredType const& owner)
    {
        Property const made = named<Property>(name);
        made->setOwningType(owner);
        return made;
    }
    Operation operation(ustring const& name, StructuredType const& owner)
    {
        Operation const made = named<Operation>(name);
        made->setOwningType(owner);
        return made;
    }
    EnumLiteral literal(ustring const& name, int value, Enum const& owner)
    {
        EnumLiteral const made = named<EnumLiteral>(name);
        made->setValue(value);
        made->setParentEnum(owner);
        return made;
    }
    template <class Handle> Handle named(ustring const& name)
    {
        Handle const made = Handle::create(m_model);
        made->setName(name);
        return made;
    }

    void expectConsistent() { EXPECT_THAT(m_model->checkInvariants(), ::testing::IsEmpty()); }

    Model m_model = Model::createRegistryModel(u"sketch");
};

/// The same in an ordinary model, whose elements may refer to those of the registry.
class OrdinarySketch : public MetamodelSketch
{
protected:
    OrdinarySketch() { m_model = Model::create(ModelConstellation()); }
};
}  // namespace tarn::kiln::meta
