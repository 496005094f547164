// Made from garden.json by `metagen.py`; do not edit.
/// \file
/// The handle of a `Tree`.
#pragma once
#include "acme/garden/Fwd.h"
#include "acme/garden/Plant.h"

namespace acme::garden {

/// A plant that stays.
///
/// The handle is shared: copies refer to the same tree; it is false when empty or when the tree was
/// destroyed.
///
/// Threads: handles may be copied and dropped anywhere; all else happens on the thread that uses
/// the model.
class Tree : public Plant
{
public:
    class Impl;            // TreeImpl.h
    class Builder;         // TreeBuilder.h
    class Constrainables;  // TreeConstrainables.h

    Tree() = default;
    explicit Tree(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The tree behind `element`; empty if that is empty or something else.
    static Tree cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static Tree create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace acme::garden
