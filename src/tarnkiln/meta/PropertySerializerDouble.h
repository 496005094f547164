/// \file
/// Real numbers, in today's form and in that of old documents.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"

namespace tarn::kiln::meta {

/// The shortest text that reads back as the same number, with a point as the decimal separator:
/// "0.1", "-0", "1e+22", "NaN", "Infinity", "-Infinity".
class TARNKILN_EXPORT PropertySerializerDouble : public DefaultPropertySerializer<double>
{
public:
    using DefaultPropertySerializer::DefaultPropertySerializer;
    ~PropertySerializerDouble() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(double const& value) const override;
    double doParseValue(ustring const& text) const override;
};

/// Writes the same, but reads only texts with a comma or, if there is none, a slash in place of the
/// point. Without either it refuses a number that is valid otherwise: "1,5" is one, "15" is none.
class TARNKILN_EXPORT PropertySerializerDoubleBackwardsCompatible : public PropertySerializerDouble
{
public:
    using PropertySerializerDouble::PropertySerializerDouble;
    ~PropertySerializerDoubleBackwardsCompatible() override;

protected:
    // DefaultPropertySerializer
    double doParseValue(ustring const& text) const override;
};
}  // namespace tarn::kiln::meta
