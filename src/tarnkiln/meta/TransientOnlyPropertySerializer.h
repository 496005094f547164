/// \file
/// The text of what must not get into a document.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"

namespace tarn::kiln::meta {

/// Writes every value as the empty text and reads every text as `T()`, such as an empty handle.
template <class T> class TransientOnlyPropertySerializer : public DefaultPropertySerializer<T>
{
public:
    using DefaultPropertySerializer<T>::DefaultPropertySerializer;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(T const&) const override { return {}; }
    T doParseValue(ustring const&) const override { return T(); }
};
}  // namespace tarn::kiln::meta
