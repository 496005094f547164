#include "tarnkiln/kernel/internal/uuidText.h"

#include <cstddef>
#include <cstdint>

namespace tarn::kiln::internal {
namespace {

constexpr std::size_t LENGTH = 36;

bool isHyphenAt(std::size_t at)
{
    return at == 8 || at == 13 || at == 18 || at == 23;
}

int valueOf(char16_t digit)
{
    if (digit >= u'0' && digit <= u'9')
        return digit - u'0';
    char16_t const lower = static_cast<char16_t>(digit | 0x20);
    return lower >= u'a' && lower <= u'f' ? lower - u'a' + 10 : -1;
}
}  // namespace

ustring uuidText(UUID const& uuid)
{
    constexpr char16_t const* DIGITS = u"0123456789abcdef";
    ustring text(LENGTH, u'-');
    std::size_t at = 0;
    for (std::uint8_t const byte : uuid.data)
    {
        if (isHyphenAt(at))
            ++at;
        text[at++] = DIGITS[byte >> 4];
        text[at++] = DIGITS[byte & 0xF];
    }
    return text;
}

bool parseUuidText(std::u16string_view text, UUID& uuid)
{
    if (text.size() != LENGTH)
        return false;
    std::size_t at = 0;
    for (std::uint8_t& byte : uuid.data)
    {
        if (isHyphenAt(at) && text[at++] != u'-')
            return false;
        int const high = valueOf(text[at++]);
        int const low = valueOf(text[at++]);
        if (high < 0 || low < 0)
            return false;
        byte = static_cast<std::uint8_t>(high << 4 | low);
    }
    return true;
}
}  // namespace tarn::kiln::internal
