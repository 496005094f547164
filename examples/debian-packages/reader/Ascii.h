/// \file
/// Questions about single ASCII characters that do not depend on the locale.
#pragma once
#include <string_view>

namespace debian::ascii {

constexpr bool isDigit(char c)
{
    return c >= '0' && c <= '9';
}

constexpr bool isLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z');
}

constexpr bool isLetterOrDigit(char c)
{
    return isLetter(c) || isDigit(c);
}

/// Space and tab, the two characters that may begin a continuation line.
constexpr bool isBlank(char c)
{
    return c == ' ' || c == '\t';
}

constexpr char toLower(char c)
{
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

constexpr bool equalsIgnoringCase(std::string_view left, std::string_view right)
{
    if (left.size() != right.size())
        return false;
    for (std::size_t i = 0; i < left.size(); ++i)
    {
        if (toLower(left[i]) != toLower(right[i]))
            return false;
    }
    return true;
}

}  // namespace debian::ascii
