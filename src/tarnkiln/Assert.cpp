#include "tarnkiln/Assert.h"

#include <cstdint>
#include <cstdlib>
#include <iostream>

namespace tarn::kiln::support {
namespace {

constexpr char32_t REPLACEMENT = 0xFFFD;

bool isLeadSurrogate(char32_t unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

bool isTrailSurrogate(char32_t unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

/// The code point that starts at `index`, which moves behind it.
char32_t nextCodePoint(std::u16string_view text, std::size_t& index)
{
    char32_t const first = text[index++];
    if (isTrailSurrogate(first))
        return REPLACEMENT;
    if (!isLeadSurrogate(first))
        return first;
    if (index == text.size() || !isTrailSurrogate(text[index]))
        return REPLACEMENT;
    return 0x10000 + ((first - 0xD800) << 10) + (text[index++] - 0xDC00);
}

void printCodePoint(std::ostream& stream, char32_t point)
{
    auto const continuation = [&](int shift) {
        stream.put(static_cast<char>(0x80 | ((point >> shift) & 0x3F)));
    };

    if (point < 0x80)
    {
        stream.put(static_cast<char>(point));
    }
    else if (point < 0x800)
    {
        stream.put(static_cast<char>(0xC0 | (point >> 6)));
        continuation(0);
    }
    else if (point < 0x10000)
    {
        stream.put(static_cast<char>(0xE0 | (point >> 12)));
        continuation(6);
        continuation(0);
    }
    else
    {
        stream.put(static_cast<char>(0xF0 | (point >> 18)));
        continuation(12);
        continuation(6);
        continuation(0);
    }
}

}  // namespace

std::ostream& beginAssertionReport(AssertionSite const& site)
{
    std::cerr << "assertion failed: " << site.sentence << "\n  must hold: " << site.condition
              << '\n';
    if (*site.operands)
        std::cerr << "  with " << site.operands << ":\n";
    return std::cerr;
}

void endAssertionReport(AssertionSite const& site)
{
    std::cerr << "  at " << site.file << ':' << site.line << std::endl;
    std::abort();
}

void printAssertionText(std::ostream& stream, std::u16string_view text)
{
    for (std::size_t index = 0; index < text.size();)
        printCodePoint(stream, nextCodePoint(text, index));
}

}  // namespace tarn::kiln::support
