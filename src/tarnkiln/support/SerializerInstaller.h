/// \file
/// What the rows of a metamodel name to give a type its text forms.
#pragma once
#include "tarnkiln/meta/DataType.h"
#include "tarnkiln/meta/DatatypeSerializer.h"
#include "tarnkiln/meta/EnumPropertySerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/TransientOnlyPropertySerializer.h"

#include <memory>

namespace tarn::kiln::support {

/// Registers a serializer of class `Serializer` as the ordinary form of `type`.
template <class Serializer> void installSerializer(meta::Type const& type)
{
    meta::PropertySerializerRegistry::getInstance().registerPropertySerializer(
        type, std::make_unique<Serializer>(type), "");
}

/// Registers the three forms of an enumeration: names, numbers and public identifiers.
template <class E> void installEnumSerializers(meta::Type const& type)
{
    auto& registry = meta::PropertySerializerRegistry::getInstance();
    registry.registerPropertySerializer(
        type, std::make_unique<meta::EnumPropertySerializerAsName<E>>(type), "");
    registry.registerPropertySerializer(
        type, std::make_unique<meta::EnumPropertySerializerAsValue<E>>(type), "ID");
    registry.registerPropertySerializer(
        type, std::make_unique<meta::EnumPropertySerializerAsPublicId<E>>(type), "PublicID");
}

/// Registers what takes the values of a data type apart.
template <class Serializer> void installDatatypeSerializer(meta::Type const& type)
{
    auto const dataType = meta::DataType::cast(type);
    meta::PropertySerializerRegistry::getInstance().registerDatatypeSerializer(
        dataType, std::make_unique<Serializer>(dataType));
}
}  // namespace tarn::kiln::support
