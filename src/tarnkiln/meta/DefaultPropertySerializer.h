/// \file
/// The base of the serializers of all types whose values are carried as a C++ type.
#pragma once
#include "tarnkiln/meta/PropertySerializer.h"
#include "tarnkiln/meta/Type.h"
#include "tarnkiln/support/CarriedValue.h"

#include <vector>

namespace tarn::kiln::meta {

/// Leaves nothing to a derived class but the text of a `T`.
///
/// Values are made of the type that a caller names. They are read if they are of the standard type
/// of `T`, of the type that the serializer was made for, or of a primitive type with the qualified
/// name of that.
///
/// \tparam T  a plain type that a `Value` can hold, or an enumeration, whose values are its
///            literals.
template <class T> class TARNKILN_EXPORT DefaultPropertySerializer : public PropertySerializer
{
public:
    /// \param type  the type that the serializer is registered for.
    explicit DefaultPropertySerializer(Type const& type) : m_type(type) {}

    // PropertySerializer
    ustring serializeValue(Value const& value) const override;
    Value parseValue(ustring const& text, Type const& type) const override;
    /// Checks besides that the value can be read as an optional one.
    Value parseOptionalValue(ustring const& text, Type const& type) const override;
    Value createEmptyOptionalValue(Type const& type) const override;
    /// Of `T()`.
    Value createDefaultValue(Type const& type) const override;
    Value combineAsUnmanagedSequenceValue(Type const& type,
                                          std::vector<Value> const& values) const override;
    Value combineAsUnmanagedSetValue(Type const& type,
                                     std::vector<Value> const& values) const override;

protected:
    virtual ustring doSerializeValue(T const& value) const = 0;
    virtual T doParseValue(ustring const& text) const = 0;

    Type const& getType() const { return m_type; }

private:
    using Carried = support::CarriedValue<T>;

    Type const m_type;
};

template <class T> ustring DefaultPropertySerializer<T>::serializeValue(Value const& value) const
{
    return doSerializeValue(Carried::read(value, m_type));
}

template <class T>
Value DefaultPropertySerializer<T>::parseValue(ustring const& text, Type const& type) const
{
    return Carried::make(type, doParseValue(text));
}

template <class T>
Value DefaultPropertySerializer<T>::parseOptionalValue(ustring const& text, Type const& type) const
{
    Value const value = parseValue(text, type);
    Carried::checkOptional(value, m_type);
    return value;
}

template <class T>
Value DefaultPropertySerializer<T>::createEmptyOptionalValue(Type const& type) const
{
    return Carried::makeAbsent(type);
}

template <class T> Value DefaultPropertySerializer<T>::createDefaultValue(Type const& type) const
{
    return Carried::make(type, T());
}

template <class T>
Value DefaultPropertySerializer<T>::combineAsUnmanagedSequenceValue(
    Type const& type, std::vector<Value> const& values) const
{
    return Carried::template combine<ValueFlags::Sequence>(type, values, m_type);
}

template <class T>
Value DefaultPropertySerializer<T>::combineAsUnmanagedSetValue(
    Type const& type, std::vector<Value> const& values) const
{
    return Carried::template combine<ValueFlags::Set>(type, values, m_type);
}

extern template class TARNKILN_EXPORT DefaultPropertySerializer<bool>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<double>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<int>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<signed char>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<short>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<long>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<unsigned int>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<unsigned char>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<unsigned short>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<unsigned long>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<ustring>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<string>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<UUID>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<boost::posix_time::ptime>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<Model>;
extern template class TARNKILN_EXPORT DefaultPropertySerializer<Language>;
}  // namespace tarn::kiln::meta
