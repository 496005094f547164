/// \file
/// How each plain type is kept in a `Value` and read from it.
#include "tarnkiln/kernel/Model.h"
#include "tarnkiln/kernel/internal/TypeKind.h"
#include "tarnkiln/kernel/internal/ValuePayload.h"
#include "tarnkiln/meta/ClassImpl.h"
#include "tarnkiln/meta/ExtensionPrototype.h"
#include "tarnkiln/meta/OperationImpl.h"
#include "tarnkiln/meta/StandardTypeOf.h"
#include "tarnkiln/meta/TransactionOrigin.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <utility>

namespace tarn::kiln::support {
namespace {

template <class T> bool isStandardTypeOf(meta::Type const& type)
{
    return type.getElementImpl() && type == meta::standardTypeOf<T>();
}

/// Whether `type` can be the type of one `T`.
template <class T> bool suits(meta::Type const& type)
{
    if constexpr (std::same_as<T, long>)
        return isStandardTypeOf<long>(type) || internal::isEnumType(type);
    else if constexpr (std::same_as<T, Model>)
        return isStandardTypeOf<Model>(type) ||
               (type.getElementImpl() && type == Model::metaClass());
    else if constexpr (std::same_as<T, meta::Operation>)
    {
        auto const* const own = internal::classImpl(type);
        return own && own->isLive() &&
               (!meta::Operation::metaClass() || own->isA(meta::Operation::metaClass()));
    }
    else
        return isStandardTypeOf<T>(type);
}

bool isSingle(Value const& value)
{
    return value.getFlags() <= ValueFlags::Single;
}

/// Whether values of `T` and `type` hold the number of a literal, as an `unsigned long`.
template <class T> bool isKeptAsLiteral([[maybe_unused]] meta::Type const& type)
{
    if constexpr (std::same_as<T, long>)
        return internal::isEnumType(type);
    else
        return std::same_as<T, meta::Language>;
}

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

template <class Container> std::vector<Value> typeMapperBasedExtractor(Value const& value)
{
    Container const container = value.getValue<Container>();
    std::vector<Value> result;
    result.reserve(container.size());
    for (typename Container::value_type const& entry : container)
        result.emplace_back(value.getType(), entry);
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
}  // namespace

template <class T> Value ValueAccess<T>::make(meta::Type const& type, T const& payload)
{
    Value value(ValueMeta(Value::started(type)), nullptr);
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
        value.setPayload(payload ? new Type(static_cast<Type>(*payload)) : nullptr);
    }
    else if constexpr (OneOf<T, long, meta::Language>)
    {
        // The sign survives: the reader narrows again.
        if (isKeptAsLiteral<T>(value.m_type))
            value.setPayload(new unsigned long(static_cast<unsigned long>(payload)));
        else
            value.setPayload(new T(payload));
    }
    else
        value.setPayload(new T(payload));

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

#define TARNKILN_VALUE_CONTAINERS(T)                                                               \
    template struct TARNKILN_EXPORT ValueAccess<std::vector<T>>;                                   \
    template struct TARNKILN_EXPORT ValueAccess<std::set<T>>;
#define TARNKILN_VALUE_ACCESS(T)                                                                   \
    template struct TARNKILN_EXPORT ValueAccess<T>;                                                \
    template struct TARNKILN_EXPORT ValueAccess<boost::optional<T>>;                               \
    TARNKILN_VALUE_CONTAINERS(T)

TARNKILN_VALUE_ACCESS(bool)
TARNKILN_VALUE_ACCESS(signed char)
TARNKILN_VALUE_ACCESS(unsigned char)
TARNKILN_VALUE_ACCESS(short)
TARNKILN_VALUE_ACCESS(unsigned short)
TARNKILN_VALUE_ACCESS(int)
TARNKILN_VALUE_ACCESS(unsigned int)
TARNKILN_VALUE_ACCESS(long)
TARNKILN_VALUE_ACCESS(unsigned long)
TARNKILN_VALUE_ACCESS(double)
TARNKILN_VALUE_ACCESS(ustring)
TARNKILN_VALUE_ACCESS(string)
TARNKILN_VALUE_ACCESS(UUID)
TARNKILN_VALUE_ACCESS(boost::posix_time::ptime)
TARNKILN_VALUE_ACCESS(meta::TransactionOrigin)
TARNKILN_VALUE_ACCESS(meta::ExtensionPrototype)
TARNKILN_VALUE_ACCESS(meta::Language)
TARNKILN_VALUE_ACCESS(Model)
TARNKILN_VALUE_CONTAINERS(meta::Operation)
}  // namespace tarn::kiln::support
