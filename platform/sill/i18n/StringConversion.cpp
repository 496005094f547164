#include "sill/i18n/StringConversion.h"

#include <cstddef>

namespace sill::i18n {
namespace {

constexpr char16_t FIRST_HIGH_SURROGATE = 0xD800;
constexpr char16_t FIRST_LOW_SURROGATE = 0xDC00;
constexpr char16_t LAST_SURROGATE = 0xDFFF;
constexpr char32_t FIRST_SUPPLEMENTARY = 0x10000;
constexpr char32_t LAST_CODE_POINT = 0x10FFFF;

constexpr bool isHighSurrogate(char32_t code)
{
    return code >= FIRST_HIGH_SURROGATE && code < FIRST_LOW_SURROGATE;
}

constexpr bool isLowSurrogate(char32_t code)
{
    return code >= FIRST_LOW_SURROGATE && code <= LAST_SURROGATE;
}

/// Stands for a byte that is no UTF-8; bytes below 0x80 always are.
constexpr bool isEscapedByte(char32_t code)
{
    return code >= FIRST_LOW_SURROGATE + 0x80 && code <= FIRST_LOW_SURROGATE + 0xFF;
}

constexpr unsigned char byteAt(std::string_view bytes, std::size_t index)
{
    return static_cast<unsigned char>(bytes[index]);
}

struct Decoded
{
    char32_t code;
    std::size_t length;  // in bytes; 0 if the bytes are not well formed
};

/// Reads the first code point of `bytes`, which must not be empty.
constexpr Decoded decode(std::string_view bytes)
{
    unsigned char const lead = byteAt(bytes, 0);
    if (lead < 0x80)
        return {lead, 1};

    std::size_t length = 0;
    char32_t code = 0;
    char32_t smallest = 0;  // what a shorter form could not hold
    if ((lead & 0xE0) == 0xC0)
    {
        length = 2;
        code = lead & 0x1F;
        smallest = 0x80;
    }
    else if ((lead & 0xF0) == 0xE0)
    {
        length = 3;
        code = lead & 0x0F;
        smallest = 0x800;
    }
    else if ((lead & 0xF8) == 0xF0)
    {
        length = 4;
        code = lead & 0x07;
        smallest = FIRST_SUPPLEMENTARY;
    }
    else
    {
        return {0, 0};
    }
    if (bytes.size() < length)
        return {0, 0};

    for (std::size_t i = 1; i < length; ++i)
    {
        unsigned char const next = byteAt(bytes, i);
        if ((next & 0xC0) != 0x80)
            return {0, 0};
        code = (code << 6) | (next & 0x3F);
    }
    bool const surrogate = isHighSurrogate(code) || isLowSurrogate(code);
    if (code < smallest || code > LAST_CODE_POINT || surrogate)
        return {0, 0};
    return {code, length};
}

void appendUtf16(std::u16string& result, char32_t code)
{
    if (code < FIRST_SUPPLEMENTARY)
    {
        result += static_cast<char16_t>(code);
        return;
    }
    code -= FIRST_SUPPLEMENTARY;
    result += static_cast<char16_t>(FIRST_HIGH_SURROGATE + (code >> 10));
    result += static_cast<char16_t>(FIRST_LOW_SURROGATE + (code & 0x3FF));
}

void appendUtf8(std::string& result, char32_t code)
{
    auto const append = [&result](char32_t byte) { result += static_cast<char>(byte); };
    auto const appendTrail = [&](char32_t bits) { append(0x80 | (bits & 0x3F)); };

    if (code < 0x80)
    {
        append(code);
    }
    else if (code < 0x800)
    {
        append(0xC0 | (code >> 6));
        appendTrail(code);
    }
    else if (code < FIRST_SUPPLEMENTARY)
    {
        append(0xE0 | (code >> 12));
        appendTrail(code >> 6);
        appendTrail(code);
    }
    else
    {
        append(0xF0 | (code >> 18));
        appendTrail(code >> 12);
        appendTrail(code >> 6);
        appendTrail(code);
    }
}
}  // namespace

std::u16string to_ustring(std::string_view bytes)
{
    std::u16string result;
    result.reserve(bytes.size());
    while (!bytes.empty())
    {
        Decoded const decoded = decode(bytes);
        if (decoded.length == 0)
        {
            result += static_cast<char16_t>(FIRST_LOW_SURROGATE + byteAt(bytes, 0));
            bytes.remove_prefix(1);
        }
        else
        {
            appendUtf16(result, decoded.code);
            bytes.remove_prefix(decoded.length);
        }
    }
    return result;
}

std::string to_string(std::u16string_view text)
{
    std::string result;
    result.reserve(text.size());
    while (!text.empty())
    {
        char32_t const unit = text.front();
        text.remove_prefix(1);
        if (isHighSurrogate(unit) && !text.empty() && isLowSurrogate(text.front()))
        {
            char32_t const high = unit - FIRST_HIGH_SURROGATE;
            char32_t const low = static_cast<char32_t>(text.front()) - FIRST_LOW_SURROGATE;
            text.remove_prefix(1);
            appendUtf8(result, FIRST_SUPPLEMENTARY + (high << 10) + low);
        }
        else if (isEscapedByte(unit))
        {
            result += static_cast<char>(unit - FIRST_LOW_SURROGATE);
        }
        else
        {
            appendUtf8(result, unit);
        }
    }
    return result;
}
}  // namespace sill::i18n
