#include "textkit/regex/Glob.h"

namespace textkit::regex {
namespace {

constexpr std::size_t NONE = std::u16string_view::npos;

bool isLineEnd(char16_t unit)
{
    return (unit >= u'\n' && unit <= u'\r') || unit == 0x85 || unit == 0x2028 || unit == 0x2029;
}

bool isSurrogate(char16_t unit)
{
    return unit >= 0xD800 && unit <= 0xDFFF;
}

/// How many units the character at `at` has that a "." stands for; 0 if there is none.
std::size_t sizeOfAny(std::u16string_view subject, std::size_t at)
{
    if (at >= subject.size() || isLineEnd(subject[at]))
        return 0;
    if (!isSurrogate(subject[at]))
        return 1;
    bool const isPair = subject[at] < 0xDC00 && at + 1 < subject.size() &&
                        subject[at + 1] >= 0xDC00 && subject[at + 1] <= 0xDFFF;
    return isPair ? 2 : 0;
}
}  // namespace

std::optional<Glob> Glob::parse(std::u16string_view pattern)
{
    constexpr std::u16string_view SPECIAL = u"^$\\.*+?()[]{}|";
    Glob glob;
    std::u16string part;
    auto const endPart = [&] {
        if (!part.empty())
            glob.m_parts.emplace_back(part);
        part.clear();
    };
    for (std::size_t at = 0; at < pattern.size(); ++at)
    {
        char16_t const unit = pattern[at];
        char16_t const next = at + 1 < pattern.size() ? pattern[at + 1] : u'\0';
        if (isLineEnd(unit) || isSurrogate(unit))
            return std::nullopt;
        if (unit == u'\\' && SPECIAL.find(next) != NONE)
        {
            part += next;
            ++at;
        }
        else if (unit == u'.' && next == u'*')
        {
            endPart();
            ++at;
        }
        else if (unit == u'.')
        {
            part += Part::ANY_CHARACTER;
        }
        else if (SPECIAL.find(unit) == NONE)
        {
            part += unit;
        }
        else
        {
            return std::nullopt;
        }
    }
    endPart();
    if (glob.m_parts.empty())
        return std::nullopt;
    return glob;
}

/// Each part is taken at the first place where it stands, as no later one is better within a line;
/// what is found lies in one line, since no part has a line end.
std::optional<bool> Glob::isFoundIn(std::u16string_view subject, std::int64_t mostSteps) const
{
    auto part = m_parts.begin();
    for (std::size_t at = 0; at < subject.size();)
    {
        if (part == m_parts.begin() && part->first() != Part::ANY_CHARACTER)
        {
            at = subject.find(part->first(), at);
            if (at == NONE)
                return false;
        }
        std::size_t compared = 0;
        std::size_t const behind = part->matchAt(subject, at, compared);
        mostSteps -= static_cast<std::int64_t>(compared);
        if (mostSteps < 0)
            return std::nullopt;
        if (behind != NONE)
        {
            at = behind;
            if (++part == m_parts.end())
                return true;
        }
        else if (std::size_t const passed = sizeOfAny(subject, at))
        {
            at += passed;
        }
        else
        {
            part = m_parts.begin();
            ++at;
        }
    }
    return false;
}

inline std::size_t Glob::Part::matchAt(std::u16string_view subject, std::size_t at,
                                       std::size_t& compared) const
{
    for (char16_t const unit : m_units)
    {
        ++compared;
        std::size_t const passed = unit == ANY_CHARACTER ? sizeOfAny(subject, at)
                                   : at < subject.size() && subject[at] == unit ? 1
                                                                                : 0;
        if (passed == 0)
            return NONE;
        at += passed;
    }
    return at;
}
}  // namespace textkit::regex
