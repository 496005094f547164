/// \file
/// The process-wide directory of text forms.
///
///     auto& registry = meta::PropertySerializerRegistry::getInstance();
///     registry.registerPropertySerializer(colour, std::make_unique<ColourSerializer>(colour), "");
///     ...
///     registry.unregisterSerializers(colour);  // before the type is destroyed
#pragma once
#include "tarnkiln/Export.h"
#include "tarnkiln/kernel/Types.h"
#include "tarnkiln/kernel/Value.h"
#include "tarnkiln/meta/Fwd.h"

#include <boost/optional.hpp>

#include <memory>
#include <utility>
#include <vector>

namespace tarn::kiln::meta {

/// Owns the serializers of all types and finds them by type and *flavour*.
///
/// A flavour names one of the text forms of a type; the empty one is the ordinary form. A type is
/// told by its UUID. These are there from the start:
///
/// | Type | Flavours |
/// |---|---|
/// | `Real` | the ordinary one, "doubleBackwardsCompatible" |
/// | `Boolean` | the ordinary one, "numeric" |
/// | `DateTime` | the ordinary one, "Rev17" |
/// | `String`, `StdString`, `UUID`, integers | the ordinary one |
/// | enumerations without any of their own | the ordinary one, "ID", "PublicID" |
///
/// Threads: may be used from all threads. Serializers that are taken out are destroyed: nobody may
/// be using them.
class TARNKILN_EXPORT PropertySerializerRegistry
{
public:
    PropertySerializerRegistry(PropertySerializerRegistry const&) = delete;
    PropertySerializerRegistry& operator=(PropertySerializerRegistry const&) = delete;

    /// The one registry, made at the first call. It lives to the end of the process.
    static PropertySerializerRegistry& getInstance();

    /// \name Changing
    /// @{
    /// Enters a serializer. It replaces one that was entered for a type that is dead by now.
    ///
    /// \throws tarnkiln::messages::DuplicateTypeInRegistry  (qualified name of `type`) if there is
    ///     one for the type and the flavour, which stays.
    void registerPropertySerializer(Type const& type,
                                    std::unique_ptr<PropertySerializer> serializer,
                                    string const& flavour);
    /// The same for a data type.
    void registerDatatypeSerializer(DataType const& type,
                                    std::unique_ptr<DatatypeSerializer> serializer);
    /// Does nothing if there is none.
    void unregisterPropertySerializer(Type const& type, string const& flavour);
    /// Takes out those of all flavours, and that of a data type.
    void unregisterSerializers(Type const& type);
    /// @}

    /// \name Reading
    /// @{
    /// The serializer of a type, or of the registered type that has the same qualified name if
    /// `type` is a primitive type without one. Null if there is none.
    PropertySerializer* getPropertySerializer(Type const& type, string const& flavour) const;
    /// The same without namesakes.
    PropertySerializer* getPropertySerializerForTypeOnly(Type const& type,
                                                         string const& flavour) const;
    /// Null if there is none.
    DatatypeSerializer* getDatatypeSerializer(DataType const& type) const;

    /// The value that `text` spells in the first flavour, in the order of registration, in which it
    /// can be read, and the serializer that read it. If there is none, the registered type with
    /// the same qualified name is tried, and the value is of that type.
    ///
    /// None if no serializer reads the text. Those that all enumerations share are not asked.
    boost::optional<std::pair<Value, PropertySerializer*>>
    parseInAnyFlavour(ustring const& text, Type const& type) const;
    /// @}

private:
    struct Tables;

    PropertySerializerRegistry();
    ~PropertySerializerRegistry();

    void initialize();
    std::vector<PropertySerializer*> getAllFlavours(Type const& type) const;

    std::unique_ptr<Tables> const m_tables;
};
}  // namespace tarn::kiln::meta
