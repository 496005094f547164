/// \file
/// Elements whose class their model has extended, for tests.
#pragma once
#include "tarnkiln/collections/AbstractPrimitiveCollection.h"
#include "tarnkiln/collections/GenericCollectionInterface.h"
#include "tarnkiln/collections/ReferenceCollection.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionImpl.h"
#include "tarnkiln/meta/StandardTypes.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/Node.h"
#include "tests/support/NodeImpl.h"

#include <gmock/gmock.h>

#include <vector>

namespace testkit {

using meta::Class;
using meta::Extension;
using meta::ExtensionPrototype;
using meta::StandardTypes;
using tarnkiln::tests::RegistryElement;
using tarnkiln::tests::RegistrySession;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

constexpr std::uint32_t MANY = 0xFFFFFFFF;

inline ExtensionPrototype prototype(ustring const& name, ustring const& type = u"Integer",
                                    std::uint32_t upper = 1)
{
    ExtensionPrototype result;
    result.setName(name);
    result.setTypeName(type);
    result.setUpper(upper);
    return result;
}
/// Of a sequence, in which values may repeat.
inline ExtensionPrototype manyNumbers(ustring const& name)
{
    ExtensionPrototype result = prototype(name, u"Integer", MANY);
    result.setIsOrdered(true);
    result.setIsUnique(false);
    return result;
}
inline Value number(int payload)
{
    StandardTypes::ensureInitialized();
    return Value(StandardTypes::integerMeta, payload);
}

/// The numbers in a collection of them.
inline std::vector<int> numbersIn(Value const& collection)
{
    std::vector<int> result;
    for (Value const& entry : collection.getValue<AbstractPrimitiveCollection&>().getAllValues())
        result.push_back(entry.getValue<int>());
    return result;
}
inline std::vector<ModelElement> elementsIn(Value const& collection)
{
    return collection.getValue<ReferenceCollection&>().getAllValuesAndProxies();
}

/// A model that has added a number, a reference, numbers and references to the class of nodes.
class ExtendedElements : public ::testing::Test
{
protected:
    ExtendedElements() { extend(m_model); }
    ~ExtendedElements() override
    {
        if (m_model)
        {
            EXPECT_THAT(m_model->checkInvariants(), IsEmpty());
        }
    }

    static Class const& nodes() { return Node::metaClass(); }
    static void extend(Model const& model)
    {
        model->extendMetaclass(nodes(), prototype(u"shelf"), number(0));
        model->extendMetaclass(nodes(), prototype(u"friend", nodes()->getQualifiedName()),
                               boost::none);
        model->extendMetaclass(nodes(), manyNumbers(u"pages"), boost::none);
        ExtensionPrototype types =
            prototype(u"types", meta::Class::metaClass()->getQualifiedName(), MANY);
        types.setIsOrdered(true);
        model->extendMetaclass(nodes(), types, boost::none);
    }
    Extension extension(ustring const& name) const { return m_model->getExtension(nodes(), name); }
    Transaction begin() const { return m_model->beginTransaction(/*revertible=*/true); }

    static int shelf(Node const& node) { return node->getExtension(u"shelf").getValue<int>(); }
    static ModelElement friendOf(Node const& node)
    {
        return node->getExtension(u"friend").getValue<ModelElement>();
    }
    static void setFriend(Node const& node, Node const& other)
    {
        node->setExtension(u"friend", Value(nodes(), other));
    }
    static std::vector<int> pages(Node const& node)
    {
        return numbersIn(node->getExtension(u"pages"));
    }
    static void addPage(Node const& node, int page)
    {
        node->getExtension(u"pages").getValue<AbstractPrimitiveCollection&>().genericAdd(
            number(page));
    }
    static std::vector<ModelElement> types(Node const& node)
    {
        return elementsIn(node->getExtension(u"types"));
    }
    static void addType(Node const& node, ModelElement const& type)
    {
        node->getExtension(u"types")
            .getValue<ReferenceCollection&>()
            .getGenericInterface()
            ->genericAdd(type);
    }

    Model m_model = Model::create(ModelConstellation());
    Node m_node = Node::create(m_model);
    Node m_other = Node::create(m_model);
};
}  // namespace testkit
