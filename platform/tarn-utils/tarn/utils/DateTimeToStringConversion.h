/// \file
/// Points in time to UTF-16 text and back.
#pragma once
#include <boost/date_time/posix_time/ptime.hpp>

#include <string>
#include <string_view>

namespace tarn::utils {

/// Converts every `ptime` to a text of its own, and that text back to the same `ptime`.
///
/// The text is extended ISO: "2024-02-29T23:59:59.000001" without a zone, the fraction left out
/// where it is zero and else as long as the resolution of the clock. Years outside 0 to 9999, which
/// arithmetic can lead to, have a sign and at least four digits: "-0044-03-15T12:00:00".
/// The special values are "not-a-date-time", "+infinity" and "-infinity".
class DateTimeToStringConversion
{
public:
    DateTimeToStringConversion() = delete;

    static std::u16string toUstring(boost::posix_time::ptime const& time);

    /// \throws std::bad_cast  if `text` is nothing that `toUstring` gives.
    static boost::posix_time::ptime fromUstring(std::u16string_view text);
};
}  // namespace tarn::utils
