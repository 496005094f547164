/// \file
/// A model for elements of the generated classes, and their properties by name.
#pragma once
#include "shapes/ShapesMetaPackage.h"
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/kernel/Transaction.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/support/ExpectRaises.h"

#include <gtest/gtest.h>

namespace testkit::shapes {

/// A model of its own for each test.
class ShapesTest : public testing::Test
{
protected:
    static meta::Property property(meta::Class const& owner, ustring const& name)
    {
        return owner->getPropertyByName(name);
    }
    static Value read(ModelElement const& element, ustring const& name)
    {
        return element->getPropertyValue(property(element->getMetaClass(), name),
                                         ModelElement::Impl::PUBLIC_ACCESS);
    }
    static void write(ModelElement const& element, ustring const& name, Value const& value)
    {
        element->setPropertyValue(property(element->getMetaClass(), name), value,
                                  ModelElement::Impl::PUBLIC_ACCESS);
    }
    /// Undoes what `change` does and leaves the model sound.
    template <class Change> void takeBack(Change change)
    {
        {
            Transaction const dropped = m_model->beginTransaction(/*revertible=*/true);
            change();
        }
        EXPECT_EQ(m_model->checkInvariants(), std::vector<string>());
    }

    Model const m_model = Model::create(ModelConstellation());
};
}  // namespace testkit::shapes
