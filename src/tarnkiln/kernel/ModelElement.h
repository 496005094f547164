/// \file
/// The handle of an element of a model.
#pragma once
#include "tarnkiln/kernel/ElementHandle.h"

namespace tarn::kiln {

/// An element of any class.
///
/// The class is a handle: copies share the element; it is false when empty or when the element was
/// destroyed. Operations are called through `operator->`.
///
/// Threads: handles may be copied and dropped anywhere; all else happens on the thread that uses
/// the element's model.
class TARNKILN_EXPORT ModelElement : public ElementHandle
{
public:
    class Impl;            // ModelElementImpl.h
    class Builder;         // ModelElementBuilder.h
    class Constrainables;  // query/ModelElementConstrainables.h

    ModelElement() = default;
    explicit ModelElement(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// A stand-in of class `metaClass`, in `model`, for the element that `id` names.
    ///
    /// If no builder is registered for the class, the stand-in is a reflective element.
    /// \throws tarnkiln::messages::NoSuchType  (qualified name of the class) if such a class is
    ///     abstract or lies in the registry model: it can't be used.
    static ModelElement createProxy(Model const& model, meta::Class const& metaClass,
                                    ProxyId const& id);
    /// A new element of a class that has no generated code; the nil UUID stands for a fresh one.
    ///
    /// The class may be any, an abstract one too, and keeps the properties that it has now.
    /// \throws tarnkiln::messages::CannotCreateWithoutModel  if `model` is empty or dead.
    /// \throws tarnkiln::messages::CannotUsePropertyWithoutType, UnsupportedQualification,
    ///     InvalidValue  if a property of the class is incomplete: see
    ///     `ReflectiveModelElementImpl`.
    /// \throws tarnkiln::messages::UUIDConflict  if the model has an element with that UUID.
    static ModelElement createReflective(Model const& model, meta::Class const& metaClass,
                                         UUID const& id = {});

    /// The class of all elements.
    static meta::Class const& metaClass();
    /// Creates that class; called once, when the registry starts.
    static void initializeType(meta::MetaRegistry& registry);

    static ModelElement cast(ModelElement const& element) { return element; }

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln
