/// \file
/// A metamodel made by hand, in a model of the test's own, for tests about values.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/ModelConstellation.h"
#include "tarnkiln/kernel/ModelElement.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Class.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/DataTypeImpl.h"
#include "tarnkiln/meta/Enum.h"
#include "tarnkiln/meta/EnumImpl.h"
#include "tarnkiln/meta/EnumLiteral.h"
#include "tarnkiln/meta/EnumLiteralImpl.h"
#include "tarnkiln/meta/Property.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace tarnkiln::tests {

using namespace tarn::kiln;

constexpr std::uint32_t MANY = 0xFFFFFFFF;

/// The types of the tests have bare names, since no package owns them.
///
/// | Type | Kind |
/// |---|---|
/// | Book | a class that extends the class of all elements |
/// | Novel | a class that extends Book |
/// | Person | a class that extends the class of all elements |
/// | Colour | an enumeration, with the literals Red (3) and Blue (-1) |
/// | Address | a data type |
class ValueFixture : public testing::Test
{
protected:
    ValueFixture()
    {
        meta::StandardTypes::ensureInitialized();
        root = meta::Class::cast(ModelElement::metaClass());
        book = makeClass(u"Book", root);
        novel = makeClass(u"Novel", book);
        person = makeClass(u"Person", root);
        colour = meta::Enum::create(model);
        colour->setName(u"Colour");
        red = makeLiteral(u"Red", 3);
        blue = makeLiteral(u"Blue", -1);
        address = meta::DataType::create(model);
        address->setName(u"Address");
    }

    meta::Class makeClass(ustring const& name, meta::Class const& superclass)
    {
        meta::Class const result = meta::Class::create(model);
        result->setName(name);
        result->setSuperclass(superclass);
        return result;
    }

    meta::EnumLiteral makeLiteral(ustring const& name, int value)
    {
        meta::EnumLiteral const result = meta::EnumLiteral::create(model);
        result->setName(name);
        result->setValue(value);
        result->setParentEnum(colour);
        return result;
    }

    /// A property that no class has.
    meta::Property makeProperty(meta::Type const& type, std::uint32_t lower, std::uint32_t upper,
                                bool ordered = false)
    {
        meta::Property const result = meta::Property::create(model);
        result->setName(u"property");
        result->setType(type);
        result->setLower(lower);
        result->setUpper(upper);
        result->setIsOrdered(ordered);
        return result;
    }

    /// A many-valued property with keys of type `String`.
    meta::Property makeQualifiedProperty(meta::Type const& type, bool uniqueKeys)
    {
        meta::Property const result = makeProperty(type, 0, MANY);
        result->setQualifiedBy(makeProperty(meta::StandardTypes::stringMeta, 1, 1));
        result->setIsQualificationUnique(uniqueKeys);
        return result;
    }

    Model const model = Model::create(ModelConstellation());
    Transaction const transaction = model->beginTransaction(/*revertible=*/true);
    meta::Class root;
    meta::Class book;
    meta::Class novel;
    meta::Class person;
    meta::Enum colour;
    meta::EnumLiteral red;
    meta::EnumLiteral blue;
    meta::DataType address;
};
}  // namespace tarnkiln::tests
