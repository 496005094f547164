#include "tarnkiln/meta/PropertySerializerLexicalCastable.h"

#include "sill/i18n/StringConversion.h"

#include <boost/lexical_cast.hpp>
#include <boost/uuid/uuid_io.hpp>

#include <limits>

namespace tarn::kiln::meta {

template <class T>
PropertySerializerLexicalCastable<T>::~PropertySerializerLexicalCastable() = default;

template <class T>
ustring PropertySerializerLexicalCastable<T>::doSerializeValue(T const& value) const
{
    return sill::i18n::to_ustring(boost::lexical_cast<string>(value));
}

template <class T> T PropertySerializerLexicalCastable<T>::doParseValue(ustring const& text) const
{
    return boost::lexical_cast<T>(sill::i18n::to_string(text));
}

template <class T>
PropertySerializerIntLexicalCastable<T>::~PropertySerializerIntLexicalCastable() = default;

template <class T>
ustring PropertySerializerIntLexicalCastable<T>::doSerializeValue(T const& value) const
{
    return sill::i18n::to_ustring(boost::lexical_cast<string>(static_cast<int>(value)));
}

template <class T>
T PropertySerializerIntLexicalCastable<T>::doParseValue(ustring const& text) const
{
    int const number = boost::lexical_cast<int>(sill::i18n::to_string(text));
    if (number < std::numeric_limits<T>::min() || number > std::numeric_limits<T>::max())
        throw boost::bad_lexical_cast(typeid(string), typeid(T));
    return static_cast<T>(number);
}

template class PropertySerializerLexicalCastable<bool>;
template class PropertySerializerLexicalCastable<int>;
template class PropertySerializerLexicalCastable<short>;
template class PropertySerializerLexicalCastable<long>;
template class PropertySerializerLexicalCastable<unsigned int>;
template class PropertySerializerLexicalCastable<unsigned short>;
template class PropertySerializerLexicalCastable<unsigned long>;
template class PropertySerializerLexicalCastable<string>;
template class PropertySerializerLexicalCastable<UUID>;
template class PropertySerializerIntLexicalCastable<signed char>;
template class PropertySerializerIntLexicalCastable<unsigned char>;
}  // namespace tarn::kiln::meta
