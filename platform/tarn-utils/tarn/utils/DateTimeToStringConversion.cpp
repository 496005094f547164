#include "tarn/utils/DateTimeToStringConversion.h"

#include <boost/date_time/posix_time/posix_time_types.hpp>

#include <cstddef>
#include <cstdint>
#include <typeinfo>

namespace tarn::utils {
namespace {

using boost::posix_time::ptime;
using boost::posix_time::time_duration;

constexpr std::u16string_view NOT_A_DATE_TIME = u"not-a-date-time";
constexpr std::u16string_view POSITIVE_INFINITY = u"+infinity";
constexpr std::u16string_view NEGATIVE_INFINITY = u"-infinity";

constexpr std::int64_t SECONDS_PER_DAY = 24 * 60 * 60;
constexpr std::int64_t DAYS_PER_ERA = 146097;          // 400 years; then the calendar repeats
constexpr std::int64_t JULIAN_DAY_OF_ERA_0 = 1721120;  // 1 March of the year 0

std::int64_t ticksPerSecond()
{
    return time_duration::ticks_per_second();
}

/// The point in time whose own count of ticks is zero, the beginning of Julian day 0. Measured from
/// there no `ptime` is too far away, and only the special ones are at a special distance.
ptime origin()
{
    ptime const epoch(boost::gregorian::date(1970, 1, 1));
    std::int64_t const julianDay = epoch.date().julian_day();
    return epoch - time_duration(0, 0, 0, julianDay * SECONDS_PER_DAY * ticksPerSecond());
}

std::int64_t floorDivide(std::int64_t dividend, std::int64_t divisor)
{
    return dividend / divisor - (dividend % divisor < 0 ? 1 : 0);
}

struct CivilDate
{
    std::int64_t year;
    std::int64_t month;
    std::int64_t day;
};

/// In the Gregorian calendar, extended in both directions. Years begin in March inside this
/// function and the next, so that the leap day is the last of its year.
CivilDate toCivilDate(std::int64_t julianDay)
{
    std::int64_t const days = julianDay - JULIAN_DAY_OF_ERA_0;
    std::int64_t const era = floorDivide(days, DAYS_PER_ERA);
    std::int64_t const dayOfEra = days - era * DAYS_PER_ERA;
    std::int64_t const yearOfEra =
        (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    std::int64_t const dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    std::int64_t const monthFromMarch = (5 * dayOfYear + 2) / 153;

    std::int64_t const month = monthFromMarch < 10 ? monthFromMarch + 3 : monthFromMarch - 9;
    return {era * 400 + yearOfEra + (month <= 2 ? 1 : 0), month,
            dayOfYear - (153 * monthFromMarch + 2) / 5 + 1};
}

std::int64_t toJulianDay(CivilDate const& date)
{
    std::int64_t const year = date.year - (date.month <= 2 ? 1 : 0);
    std::int64_t const era = floorDivide(year, 400);
    std::int64_t const yearOfEra = year - era * 400;
    std::int64_t const monthFromMarch = date.month > 2 ? date.month - 3 : date.month + 9;
    std::int64_t const dayOfYear = (153 * monthFromMarch + 2) / 5 + date.day - 1;
    std::int64_t const dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
    return era * DAYS_PER_ERA + dayOfEra + JULIAN_DAY_OF_ERA_0;
}

void appendNumber(std::u16string& text, std::int64_t number, std::size_t width)
{
    std::u16string digits;
    for (; number > 0 || digits.size() < width; number /= 10)
        digits.insert(digits.begin(), static_cast<char16_t>(u'0' + number % 10));
    text += digits;
}

void appendYear(std::u16string& text, std::int64_t year)
{
    if (year < 0 || year > 9999)
        text += year < 0 ? u'-' : u'+';
    appendNumber(text, year < 0 ? -year : year, 4);
}

/// Reads a text from its beginning; raises `std::bad_cast` where it is not what is expected.
class Reader
{
public:
    explicit Reader(std::u16string_view text) : m_rest(text) {}

    bool atEnd() const { return m_rest.empty(); }

    bool skipIf(char16_t unit)
    {
        bool const found = m_rest.starts_with(unit);
        if (found)
            m_rest.remove_prefix(1);
        return found;
    }

    void skip(char16_t unit)
    {
        if (!skipIf(unit))
            throw std::bad_cast();
    }

    std::int64_t readNumber(std::size_t fewestDigits, std::size_t mostDigits)
    {
        std::int64_t result = 0;
        std::size_t count = 0;
        for (; count < mostDigits && !atEnd() && isDigit(m_rest.front()); ++count)
        {
            result = result * 10 + (m_rest.front() - u'0');
            m_rest.remove_prefix(1);
        }
        if (count < fewestDigits)
            throw std::bad_cast();
        return result;
    }

    std::int64_t readYear()
    {
        constexpr std::size_t MOST_DIGITS = 6;  // more than any `ptime` needs
        if (skipIf(u'-'))
            return -readNumber(4, MOST_DIGITS);
        return skipIf(u'+') ? readNumber(4, MOST_DIGITS) : readNumber(4, 4);
    }

private:
    static bool isDigit(char16_t unit) { return unit >= u'0' && unit <= u'9'; }

    std::u16string_view m_rest;
};

/// Takes fields out of range as they come, and wraps around where the clock ends.
ptime parseOrdinary(std::u16string_view text)
{
    Reader reader(text);
    CivilDate date = {};
    date.year = reader.readYear();
    reader.skip(u'-');
    date.month = reader.readNumber(2, 2);
    reader.skip(u'-');
    date.day = reader.readNumber(2, 2);
    reader.skip(u'T');
    std::int64_t const hours = reader.readNumber(2, 2);
    reader.skip(u':');
    std::int64_t const minutes = reader.readNumber(2, 2);
    reader.skip(u':');
    std::int64_t const seconds = reader.readNumber(2, 2);
    std::size_t const fractionDigits = time_duration::num_fractional_digits();
    std::int64_t const fraction =
        reader.skipIf(u'.') ? reader.readNumber(fractionDigits, fractionDigits) : 0;
    if (!reader.atEnd())
        throw std::bad_cast();

    // Unsigned, since only that may wrap.
    std::uint64_t ticks = static_cast<std::uint64_t>(toJulianDay(date));
    ticks *= static_cast<std::uint64_t>(SECONDS_PER_DAY);
    ticks += static_cast<std::uint64_t>((hours * 60 + minutes) * 60 + seconds);
    ticks *= static_cast<std::uint64_t>(ticksPerSecond());
    ticks += static_cast<std::uint64_t>(fraction);
    return origin() + time_duration(0, 0, 0, static_cast<std::int64_t>(ticks));
}
}  // namespace

std::u16string DateTimeToStringConversion::toUstring(ptime const& time)
{
    if (time.is_not_a_date_time())
        return std::u16string(NOT_A_DATE_TIME);
    if (time.is_infinity())
        return std::u16string(time.is_pos_infinity() ? POSITIVE_INFINITY : NEGATIVE_INFINITY);

    std::int64_t const ticks = (time - origin()).ticks();
    std::int64_t const allSeconds = floorDivide(ticks, ticksPerSecond());
    std::int64_t const fraction =
        ((ticks % ticksPerSecond()) + ticksPerSecond()) % ticksPerSecond();
    std::int64_t const julianDay = floorDivide(allSeconds, SECONDS_PER_DAY);
    std::int64_t const seconds = allSeconds - julianDay * SECONDS_PER_DAY;
    CivilDate const date = toCivilDate(julianDay);

    std::u16string text;
    appendYear(text, date.year);
    text += u'-';
    appendNumber(text, date.month, 2);
    text += u'-';
    appendNumber(text, date.day, 2);
    text += u'T';
    appendNumber(text, seconds / 3600, 2);
    text += u':';
    appendNumber(text, seconds / 60 % 60, 2);
    text += u':';
    appendNumber(text, seconds % 60, 2);
    if (fraction != 0)
    {
        text += u'.';
        appendNumber(text, fraction, time_duration::num_fractional_digits());
    }
    return text;
}

ptime DateTimeToStringConversion::fromUstring(std::u16string_view text)
{
    if (text == NOT_A_DATE_TIME)
        return ptime(boost::posix_time::not_a_date_time);
    if (text == POSITIVE_INFINITY)
        return ptime(boost::posix_time::pos_infin);
    if (text == NEGATIVE_INFINITY)
        return ptime(boost::posix_time::neg_infin);

    // What does not exist, such as 30 February, comes back as another text.
    ptime const result = parseOrdinary(text);
    if (toUstring(result) != text)
        throw std::bad_cast();
    return result;
}
}  // namespace tarn::utils
