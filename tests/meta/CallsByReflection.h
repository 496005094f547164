/// \file
/// A class with methods, and how tests declare operations for it.
#pragma once
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/InvokerImpl.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tests/meta/RegistrySession.h"
#include "tests/support/ExpectRaises.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"
#include "tests/support/SpecialNodeImpl.h"

#include <gmock/gmock.h>

namespace testkit {

/// A node with methods of every kind.
class Machine : public Node::Impl
{
public:
    using Node::Impl::Impl;

    int subtract(int from, int what) const { return from - what; }
    void call(ustring const& name) { setName(name); }
    virtual ustring speak() const { return u"machine"; }
};

class LoudMachine : public Machine
{
public:
    using Machine::Machine;
    ustring speak() const override { return u"MACHINE"; }
};

/// A model, and operations of the class of nodes, which go with the test.
class CallsByReflection : public ::testing::Test
{
protected:
    using Arguments = std::vector<Value>;

    ~CallsByReflection() override
    {
        tarnkiln::tests::RegistrySession session;
        for (meta::Operation const& operation : m_declared)
        {
            if (operation)
                operation->destroy();
        }
        session.commit();
    }

    template <class Impl> Node make() const
    {
        Node const made(new Impl(m_model, UUID()));
        made->notifyCreated();
        return made;
    }

    meta::Operation declare(std::unique_ptr<meta::AbstractMethodInvoker> invoker,
                            meta::Type const& type = {},
                            meta::StructuredType const& owner = Node::metaClass())
    {
        tarnkiln::tests::RegistrySession session;
        auto const operation = meta::Operation::create(session.getModel());
        m_declared.push_back(operation);
        operation->setName(u"run");
        operation->setType(type);
        operation->setOwningType(owner);
        operation->setInvoker(std::move(invoker));
        session.commit();
        return operation;
    }
    template <class Method>
    meta::Operation declareMethod(Method method, meta::Type const& type = {},
                                  meta::StructuredType const& owner = Node::metaClass())
    {
        return declare(meta::makeInvoker(method), type, owner);
    }
    /// Changes an operation of the registry.
    template <class Change> static void change(Change const& make)
    {
        tarnkiln::tests::RegistrySession session;
        make();
        session.commit();
    }

    template <class T> static meta::Type const& typeOf() { return meta::standardTypeOf<T>(); }
    template <class T> static Value value(T const& payload) { return Value(typeOf<T>(), payload); }
    static Value text(ustring const& payload) { return value(payload); }

    static boost::optional<Value> invoke(ModelElement const& element,
                                         meta::Operation const& operation,
                                         Arguments const& arguments = {})
    {
        return element->invoke(operation, arguments, ModelElement::Impl::PUBLIC_ACCESS);
    }

    Model const m_model = Model::create(ModelConstellation());
    std::vector<meta::Operation> m_declared;
};
}  // namespace testkit
