/// \file
/// Short ways through the registry of serializers.
#pragma once
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/meta/PropertySerializerRegistry.h"
#include "tarnkiln/meta/StandardTypes.h"

#include <gtest/gtest.h>

#include <stdexcept>

namespace tarnkiln::tests {

inline tarn::kiln::meta::PropertySerializer& serializerOf(tarn::kiln::meta::Type const& type,
                                                          char const* flavour = "")
{
    auto* const serializer =
        tarn::kiln::meta::PropertySerializerRegistry::getInstance().getPropertySerializer(type,
                                                                                          flavour);
    if (!serializer)
        throw std::logic_error("no such serializer");
    return *serializer;
}

/// The text of a value that carries `payload`.
template <class T>
tarn::kiln::ustring write(tarn::kiln::meta::Type const& type, T const& payload,
                          char const* flavour = "")
{
    return serializerOf(type, flavour).serializeValue(tarn::kiln::Value(type, payload));
}

/// What the value that `text` spells carries.
template <class T>
T read(tarn::kiln::meta::Type const& type, tarn::kiln::ustring const& text,
       char const* flavour = "")
{
    return serializerOf(type, flavour).parseValue(text, type).template getValue<T>();
}
}  // namespace tarnkiln::tests

/// Expects that the serializer of a type, and perhaps a flavour, can't read the text.
#define EXPECT_UNREADABLE(text, ...)                                                               \
    EXPECT_THROW(static_cast<void>(::tarnkiln::tests::serializerOf(__VA_ARGS__)                    \
                                       .parseValue(text, std::get<0>(std::tuple(__VA_ARGS__)))),   \
                 std::bad_cast)                                                                    \
        << ::testing::PrintToString(::tarn::kiln::ustring(text))
