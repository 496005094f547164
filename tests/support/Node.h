/// \file
/// The handle of an element with a property of every shape.
#pragma once
#include "tarnkiln/kernel/ModelElement.h"

namespace testkit {

using namespace tarn::kiln;

/// An element with a property of every shape.
///
/// Threads: as all elements.
class Node : public ModelElement
{
public:
    class Impl;     // NodeImpl.h
    class Builder;  // NodeBuilder.h

    Node() = default;
    explicit Node(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The node behind `element`; empty if that is empty or something else.
    static Node cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Node create(Model const& model, UUID const& id = {});

    /// Stands in `model` for the element that `id` names.
    static Node createProxy(Model const& model, ProxyId const& id);
    /// How many nodes, of both classes, are in memory now.
    static long liveCount();

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace testkit
