// Made from catalogue.json by `tools/metagen/metagen.py`; do not edit.
/// \file
/// The handle of one literal of an enumeration.
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/meta/Fwd.h"
#include "tarnkiln/meta/NamedElement.h"

namespace tarn::kiln::meta {

/// One named value of an `Enum`.
///
/// The enumeration owns its literals and keys them by name; their values may repeat.
///
/// The handle is shared: copies refer to the same enum literal; it is false when empty or when the
/// enum literal was destroyed.
///
/// Threads: handles may be copied and dropped anywhere. What belongs to the registry may be read on
/// any thread; all else happens on the thread that uses the model.
class TARNKILN_EXPORT EnumLiteral : public NamedElement
{
public:
    class Impl;            // EnumLiteralImpl.h
    class Builder;         // EnumLiteralBuilder.h
    class Constrainables;  // EnumLiteralConstrainables.h

    EnumLiteral() = default;
    explicit EnumLiteral(Impl* impl);  ///< Shares `impl`; null gives the empty handle.

    /// The enum literal behind `element`; empty if that is empty or something else.
    static EnumLiteral cast(ModelElement const& element);
    static meta::Class const& metaClass();
    /// A new one in `model`; the nil UUID stands for a fresh one.
    static EnumLiteral create(Model const& model, UUID const& id = {});

    Impl* getImpl() const;     ///< Null for the empty handle; lives as long as this handle.
    Impl* operator->() const;  ///< All operations of the element; the handle must not be empty.
};
}  // namespace tarn::kiln::meta
