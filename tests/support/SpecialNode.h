/// \file
/// The handle of a node of a subclass.
#pragma once
#include "tests/support/Node.h"

namespace testkit {

/// A `Node` with properties of its own.
///
/// Threads: as all elements.
class SpecialNode : public Node
{
public:
    class Impl;     // SpecialNodeImpl.h
    class Builder;  // SpecialNodeBuilder.h

    SpecialNode() = default;
    explicit SpecialNode(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The special node behind `element`; empty if that is empty or something else.
    static SpecialNode cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static SpecialNode create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace testkit
