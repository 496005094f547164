#include "reader/PackageName.h"

#include "reader/Ascii.h"

#include <algorithm>

namespace debian {

bool mayStandInPackageName(char c)
{
    return ascii::isLetterOrDigit(c) || c == '-' || c == '+' || c == '.' || c == '_';
}

bool mayStandInArchitecture(char c)
{
    return ascii::isLetterOrDigit(c) || c == '-';
}

bool isPackageName(std::string_view text)
{
    return !text.empty() && ascii::isLetterOrDigit(text.front()) &&
           std::all_of(text.begin(), text.end(), mayStandInPackageName);
}

bool isArchitecture(std::string_view text)
{
    return !text.empty() && ascii::isLetterOrDigit(text.front()) &&
           std::all_of(text.begin(), text.end(), mayStandInArchitecture);
}

}  // namespace debian
