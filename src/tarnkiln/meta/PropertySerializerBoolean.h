/// \file
/// Truth values as words.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"

namespace tarn::kiln::meta {

/// "true" and "false", spelled exactly so.
class TARNKILN_EXPORT PropertySerializerBoolean : public DefaultPropertySerializer<bool>
{
public:
    using DefaultPropertySerializer::DefaultPropertySerializer;
    ~PropertySerializerBoolean() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(bool const& value) const override;
    bool doParseValue(ustring const& text) const override;
};
}  // namespace tarn::kiln::meta
