/// \file
/// The texts that `boost::lexical_cast` gives and takes.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"

namespace tarn::kiln::meta {

/// | T | Text |
/// |---|---|
/// | integers | decimal; read with an optional sign and within the range of `T`. A minus sign |
/// |          | before an unsigned number counts down from beyond the greatest one |
/// | `bool` | "1" or "0"; read with a sign and leading zeros too |
/// | `string` | the text itself, in UTF-8 |
/// | `UUID` | 36 characters, hexadecimal digits in lower case and dashes |
///
/// \tparam T  one of those, but no integer of one byte.
template <class T>
class TARNKILN_EXPORT PropertySerializerLexicalCastable : public DefaultPropertySerializer<T>
{
public:
    using DefaultPropertySerializer<T>::DefaultPropertySerializer;
    ~PropertySerializerLexicalCastable() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(T const& value) const override;
    T doParseValue(ustring const& text) const override;
};

/// Integers of one byte, as numbers and not as characters.
///
/// \tparam T  `signed char` or `unsigned char`.
template <class T>
class TARNKILN_EXPORT PropertySerializerIntLexicalCastable : public DefaultPropertySerializer<T>
{
public:
    using DefaultPropertySerializer<T>::DefaultPropertySerializer;
    ~PropertySerializerIntLexicalCastable() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(T const& value) const override;
    T doParseValue(ustring const& text) const override;
};

extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<bool>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<int>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<short>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<long>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<unsigned int>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<unsigned short>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<unsigned long>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<string>;
extern template class TARNKILN_EXPORT PropertySerializerLexicalCastable<UUID>;
extern template class TARNKILN_EXPORT PropertySerializerIntLexicalCastable<signed char>;
extern template class TARNKILN_EXPORT PropertySerializerIntLexicalCastable<unsigned char>;
}  // namespace tarn::kiln::meta
