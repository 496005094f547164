#include "reader/Utf8.h"

#include <cstdint>
#include <cstring>

namespace debian {
namespace {

/// The length of the plain ASCII run at the start of `text`; may stop up to seven bytes early.
std::size_t skipAscii(std::string_view text)
{
    std::size_t done = 0;
    while (text.size() - done >= sizeof(std::uint64_t))
    {
        std::uint64_t word;
        std::memcpy(&word, text.data() + done, sizeof word);
        if ((word & 0x8080808080808080u) != 0)
            break;
        done += sizeof word;
    }
    return done;
}

/// The length of the well-formed sequence that `text` begins with, 0 if there is none.
std::size_t sequenceLength(std::string_view text)
{
    auto byte = [&](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    unsigned const first = byte(0);
    if (first < 0x80)
        return 1;

    // The range of the second byte excludes overlong forms, surrogates and what is above U+10FFFF.
    std::size_t length = 0;
    unsigned low = 0x80;
    unsigned high = 0xBF;
    if (first >= 0xC2 && first <= 0xDF)
    {
        length = 2;
    }
    else if (first >= 0xE0 && first <= 0xEF)
    {
        length = 3;
        low = first == 0xE0 ? 0xA0 : low;
        high = first == 0xED ? 0x9F : high;
    }
    else if (first >= 0xF0 && first <= 0xF4)
    {
        length = 4;
        low = first == 0xF0 ? 0x90 : low;
        high = first == 0xF4 ? 0x8F : high;
    }
    else
    {
        return 0;
    }

    if (text.size() < length || byte(1) < low || byte(1) > high)
        return 0;
    for (std::size_t i = 2; i < length; ++i)
    {
        if (byte(i) < 0x80 || byte(i) > 0xBF)
            return 0;
    }
    return length;
}

}  // namespace

std::size_t findInvalidUtf8(std::string_view text)
{
    std::size_t done = skipAscii(text);
    while (done < text.size())
    {
        std::size_t const length = sequenceLength(text.substr(done));
        if (length == 0)
            return done;
        done += length;
    }
    return std::string_view::npos;
}

}  // namespace debian
