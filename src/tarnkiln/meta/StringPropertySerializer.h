/// \file
/// Texts as they are.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"

namespace tarn::kiln::meta {

/// The text of a text is the text itself.
class TARNKILN_EXPORT StringPropertySerializer : public DefaultPropertySerializer<ustring>
{
public:
    using DefaultPropertySerializer::DefaultPropertySerializer;
    ~StringPropertySerializer() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(ustring const& value) const override;
    ustring doParseValue(ustring const& text) const override;
};
}  // namespace tarn::kiln::meta
