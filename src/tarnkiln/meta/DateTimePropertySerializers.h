/// \file
/// Points in time, in today's form and in that of old documents.
#pragma once
#include "tarnkiln/meta/DefaultPropertySerializer.h"

namespace tarn::kiln::meta {

/// Extended ISO, without zone: "2024-02-29T23:59:59.000001"; the special values are
/// "not-a-date-time", "+infinity" and "-infinity". Every `ptime` has a text of its own.
class TARNKILN_EXPORT DefaultDateTimeSerializer
    : public DefaultPropertySerializer<boost::posix_time::ptime>
{
public:
    using DefaultPropertySerializer::DefaultPropertySerializer;
    ~DefaultDateTimeSerializer() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(boost::posix_time::ptime const& value) const override;
    boost::posix_time::ptime doParseValue(ustring const& text) const override;
};

/// Basic ISO, without zone: "20240229T235959.000001". Reads a comma in place of the point too, and
/// besides the special values above "maximum-date-time" and "minimum-date-time".
class TARNKILN_EXPORT DateTimeSerializerRev17
    : public DefaultPropertySerializer<boost::posix_time::ptime>
{
public:
    using DefaultPropertySerializer::DefaultPropertySerializer;
    ~DateTimeSerializerRev17() override;

protected:
    // DefaultPropertySerializer
    ustring doSerializeValue(boost::posix_time::ptime const& value) const override;
    boost::posix_time::ptime doParseValue(ustring const& text) const override;
};
}  // namespace tarn::kiln::meta
