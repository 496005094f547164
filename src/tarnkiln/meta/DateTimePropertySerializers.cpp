#include "tarnkiln/meta/DateTimePropertySerializers.h"

#include "sill/i18n/StringConversion.h"
#include "tarn/utils/DateTimeToStringConversion.h"

#include <boost/date_time/posix_time/posix_time.hpp>

#include <exception>
#include <typeinfo>

namespace tarn::kiln::meta {

using boost::posix_time::ptime;
using tarn::utils::DateTimeToStringConversion;

DefaultDateTimeSerializer::~DefaultDateTimeSerializer() = default;

ustring DefaultDateTimeSerializer::doSerializeValue(ptime const& value) const
{
    return DateTimeToStringConversion::toUstring(value);
}

ptime DefaultDateTimeSerializer::doParseValue(ustring const& text) const
{
    return DateTimeToStringConversion::fromUstring(text);
}

DateTimeSerializerRev17::~DateTimeSerializerRev17() = default;

ustring DateTimeSerializerRev17::doSerializeValue(ptime const& value) const
{
    return sill::i18n::to_ustring(boost::posix_time::to_iso_string(value));
}

ptime DateTimeSerializerRev17::doParseValue(ustring const& text) const
{
    try
    {
        return boost::date_time::parse_iso_time<ptime>(sill::i18n::to_string(text), 'T');
    }
    catch (std::exception const&)
    {
        // Boost tells a date that does not exist from a text that is no date; callers expect one
        // kind of failure.
        throw std::bad_cast();
    }
}
}  // namespace tarn::kiln::meta
