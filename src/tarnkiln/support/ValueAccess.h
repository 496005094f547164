/// \file
/// How each plain type is kept in a `Value` and read from it.
///
/// Only sources that compile the access to a type include this: the library does so for the types
/// that are there in any program, generated code for the data types of its metamodel.
#pragma once
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/meta/Language.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/support/ValuePayload.h"

#include <utility>

namespace tarn::kiln::support {

template <class T> bool isStandardTypeOf(meta::Type const& type)
{
    return type.getElementImpl() && type == meta::standardTypeOf<T>();
}

/// Whether `type` can be the type of one `T`.
template <class T> bool suits(meta::Type const& type)
{
    return isStandardTypeOf<T>(type);
}
template <> bool suits<long>(meta::Type const& type);
template <> bool suits<Model>(meta::Type const& type);
template <> bool suits<meta::Operation>(meta::Type const& type);

inline bool isSingle(Value const& value)
{
    return value.getFlags() <= ValueFlags::Single;
}

/// Whether values of `T` and `type` hold the number of a literal, as an `unsigned long`.
template <class T> bool isKeptAsLiteral(meta::Type const& /*type*/)
{
    return std::same_as<T, meta::Language>;
}
template <> bool isKeptAsLiteral<long>(meta::Type const& type);

template <class T> class PlainAccess
{
public:
    static constexpr ValueFlags FLAGS = ValueFlags::Single;
    static bool isCompatible(Value const& value)
    {
        // A handle of a model, like that of an element, can express absence.
        bool const isShaped = std::same_as<T, Model> ? isSingle(value) : value.getFlags() == FLAGS;
        return isShaped && suits<T>(value.getType());
    }
};

template <class T> class PlainAccess<boost::optional<T>>
{
public:
    static constexpr ValueFlags FLAGS = ValueFlags::OptionalSingle;
    static bool isCompatible(Value const& value)
    {
        return isSingle(value) && (std::same_as<T, Model> ? suits<T>(value.getType())
                                                          : isStandardTypeOf<T>(value.getType()));
    }
};

template <class T, ValueFlags SHAPE> class ContainerAccess
{
public:
    static constexpr ValueFlags FLAGS = SHAPE;
    static bool isCompatible(Value const& value)
    {
        return value.getFlags() == FLAGS && !value.isManaged() && suits<T>(value.getType());
    }
};

template <class T>
class PlainAccess<std::vector<T>> : public ContainerAccess<T, ValueFlags::Sequence>
{};

template <class T> class PlainAccess<std::set<T>> : public ContainerAccess<T, ValueFlags::Set>
{};

/// The entries, of the type of `value`, which may be a namesake of the standard one.
template <class Container> std::vector<Value> typeMapperBasedExtractor(Value const& value)
{
    using Entry = typename Container::value_type;
    Container const container = ValueAccess<Container>::read(value);
    std::vector<Value> result;
    result.reserve(container.size());
    for (Entry const& entry : container)
    {
        if constexpr (ElementReference<Entry>)
            result.emplace_back(value.getType(), entry);
        else
            result.push_back(ValueAccess<Entry>::make(value.getType(), entry));
    }
    return result;
}

/// What a payload of the C++ type `T` looks like on the heap.
template <class T> struct Kept
{
    using Type = T;
};
template <> struct Kept<meta::Language>
{
    using Type = unsigned long;
};
template <class T> struct Kept<boost::optional<T>> : Kept<T>
{};
template <class T> Value ValueAccess<T>::make(meta::Type const& type, T const& payload)
{
    Value value(type, ValueFlags::Single, nullptr);
    store(value, payload);
    return value;
}

template <class T> void ValueAccess<T>::store(Value& value, T const& payload)
{
    value.m_flags = PlainAccess<T>::FLAGS;
    if constexpr (isOptionalPayload<T>)
    {
        using Entry = typename T::value_type;
        using Type = typename Kept<Entry>::Type;
        value.m_payload.template setType<Type>();
        if (payload)
            value.m_payload.store(static_cast<Type>(*payload));
    }
    else if constexpr (OneOf<T, long, meta::Language>)
    {
        // The sign survives: the reader narrows again.
        if (isKeptAsLiteral<T>(value.m_type))
            value.m_payload.store(static_cast<unsigned long>(payload));
        else
            value.m_payload.store(payload);
    }
    else
        value.m_payload.store(payload);

    if constexpr (isContainerPayload<T>)
    {
        value.m_managed = false;
        value.m_extractor = typeMapperBasedExtractor<T>;
    }
}

template <class T> void ValueAccess<T>::check(Value const& value)
{
    if (!PlainAccess<T>::isCompatible(value))
        value.failCast();
}

template <class T> T ValueAccess<T>::read(Value const& value)
{
    if constexpr (isOptionalPayload<T>)
    {
        using Entry = typename T::value_type;
        auto const* const payload = value.payload<typename Kept<Entry>::Type>();
        return payload ? T(static_cast<Entry>(*payload)) : T();
    }
    else
    {
        if constexpr (OneOf<T, long, meta::Language>)
            if (isKeptAsLiteral<T>(value.m_type))
            {
                auto const* const number = value.payload<unsigned long>();
                return number ? static_cast<T>(*number) : T();
            }
        T const* const payload = value.payload<T>();
        return payload ? *payload : T();
    }
}

/// Calls `X(T)` for each type that the library compiles the access to.
#define TARNKILN_FOR_EACH_PAYLOAD(X)                                                               \
    X(bool)                                                                                        \
    X(signed char)                                                                                 \
    X(unsigned char)                                                                               \
    X(short)                                                                                       \
    X(unsigned short)                                                                              \
    X(int)                                                                                         \
    X(unsigned int)                                                                                \
    X(long)                                                                                        \
    X(unsigned long)                                                                               \
    X(double)                                                                                      \
    X(::tarn::kiln::ustring)                                                                       \
    X(::tarn::kiln::string)                                                                        \
    X(::tarn::kiln::UUID)                                                                          \
    X(::boost::posix_time::ptime)                                                                  \
    X(::tarn::kiln::meta::TransactionOrigin)                                                       \
    X(::tarn::kiln::meta::ExtensionPrototype)                                                      \
    X(::tarn::kiln::meta::Language)                                                                \
    X(::tarn::kiln::Model)

// A second copy would not know the payloads of the first.
#define TARNKILN_DECLARE(T)                                                                        \
    extern template struct TARNKILN_EXPORT ValueAccess<T>;                                         \
    extern template struct TARNKILN_EXPORT ValueAccess<boost::optional<T>>;                        \
    extern template struct TARNKILN_EXPORT ValueAccess<std::vector<T>>;                            \
    extern template struct TARNKILN_EXPORT ValueAccess<std::set<T>>;
TARNKILN_FOR_EACH_PAYLOAD(TARNKILN_DECLARE)
#undef TARNKILN_DECLARE
}  // namespace tarn::kiln::support

/// Compiles the access to single, optional and combined values of `T`.
#define TARNKILN_VALUE_ACCESS(T)                                                                   \
    template struct TARNKILN_EXPORT tarn::kiln::support::ValueAccess<T>;                           \
    template struct TARNKILN_EXPORT tarn::kiln::support::ValueAccess<boost::optional<T>>;          \
    template struct TARNKILN_EXPORT tarn::kiln::support::ValueAccess<std::vector<T>>;              \
    template struct TARNKILN_EXPORT tarn::kiln::support::ValueAccess<std::set<T>>;
