#include "tarnkiln/kernel/Text.h"

#include "sill/i18n/StringConversion.h"

namespace tarn::kiln {

ustring toUstring(std::string_view bytes)
{
    return sill::i18n::to_ustring(bytes);
}

string toUtf8(std::u16string_view text)
{
    return sill::i18n::to_string(text);
}
}  // namespace tarn::kiln
