/// \file
/// A node that tells in which order its properties are recorded.
#pragma once
#include "tarnkiln/kernel/ModelImpl.h"
#include "tarnkiln/meta/PropertyImpl.h"
#include "tarnkiln/support/Handle.h"
#include "tests/support/NodeImpl.h"
#include "tests/support/NodeMetamodel.h"

#include <functional>
#include <string>
#include <vector>

namespace testkit {

/// What was recorded, as "name.property".
using RecordTrace = std::vector<std::string>;

/// A `Node` whose first change of each property in a deep transaction is traced.
class TracedNodeImpl final : public Node::Impl
{
public:
    using Node::Impl::Impl;

    void copyValue(ModelElement::Impl::Storage* storage, unsigned long index) const override
    {
        if (trace)
        {
            ustring const property = NodeMetamodel::get().properties[index]->getName();
            trace->push_back(label + '.' + std::string(property.begin(), property.end()));
        }
        if (whenRecorded)
            whenRecorded(index);
        Node::Impl::copyValue(storage, index);
    }

    std::string label;
    RecordTrace* trace = nullptr;
    std::function<void(unsigned long index)> whenRecorded;
};

/// A traced node with that label, as the handle of its class.
inline Node makeTraced(Model const& model, std::string label, RecordTrace& trace)
{
    auto* const impl = new TracedNodeImpl(model, UUID{});
    Node const node(impl);
    impl->label = std::move(label);
    impl->trace = &trace;
    node->notifyCreated();
    return node;
}
}  // namespace testkit
