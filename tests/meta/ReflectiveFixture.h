/// \file
/// A small library of books as a run-time metamodel, for the tests of reflective elements.
#pragma once
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericMapInterface.h"
#include "tarnkiln/collections/GenericMultimapInterface.h"
#include "tarnkiln/collections/GenericSequenceInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Changes.h"
#include "tarnkiln/kernel/Freezer.h"
#include "tarnkiln/kernel/ListenerHolder.h"
#include "tarnkiln/kernel/ProgressIndicators.h"
#include "tarnkiln/kernel/ProxyId.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/RuntimeMetamodel.h"
#include "tests/support/ScriptedListener.h"

#include <gmock/gmock.h>

namespace testkit {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::UnorderedElementsAre;

/// Makes elements of run-time classes, and looks at the model after each test.
class ReflectiveFixture : public ::testing::Test
{
protected:
    ~ReflectiveFixture() override { EXPECT_THAT(model->checkInvariants(), IsEmpty()); }

    ModelElement make(meta::Class const& metaClass)
    {
        return ModelElement::createReflective(model, metaClass);
    }
    Transaction begin() { return model->beginTransaction(/*revertible=*/true); }
    /// A stand-in of `metaClass` for `target`, whose id names the model of `target`, or none.
    ModelElement proxyOf(ModelElement const& target, meta::Class const& metaClass,
                         bool namesModel = false)
    {
        return ModelElement::createProxy(model, metaClass,
                                         target->getPersistentProxyId(/*omitModel=*/!namesModel));
    }
    ModelElement danglingProxy(meta::Class const& metaClass)
    {
        return ModelElement::createProxy(
            model, metaClass,
            ProxyId(ElementId::UUID_TYPE, u"00000000-0000-4000-8000-000000000001", boost::none));
    }

    RuntimeMetamodel metamodel;
    Model const model = Model::create(ModelConstellation());
};

inline GenericCollectionInterface& genericOf(ModelElement const& element,
                                             meta::Property const& property)
{
    return *referencesOf(element, property).getGenericInterface();
}
inline GenericSequenceInterface& sequenceOf(ModelElement const& element,
                                            meta::Property const& property)
{
    return dynamic_cast<GenericSequenceInterface&>(genericOf(element, property));
}
inline GenericMapInterface& mapOf(ModelElement const& element, meta::Property const& property)
{
    return dynamic_cast<GenericMapInterface&>(genericOf(element, property));
}
inline GenericMultimapInterface& multimapOf(ModelElement const& element,
                                            meta::Property const& property)
{
    return dynamic_cast<GenericMultimapInterface&>(genericOf(element, property));
}
inline std::vector<ModelElement> entriesOf(ModelElement const& element,
                                           meta::Property const& property)
{
    return referencesOf(element, property).getAllValuesAndProxies();
}
}  // namespace testkit
