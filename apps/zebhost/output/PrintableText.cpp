#include "output/PrintableText.h"

#include "output/Strings.h"

#include <foundation/zebcore/StringConversion.h>

namespace zebhost
{

namespace
{

constexpr char16_t kReplacement = u'\uFFFD';

bool IsControl(char16_t unit)
{
    return unit < 0x20 || (unit >= 0x7F && unit < 0xA0) || unit == 0x2028 || unit == 0x2029;
}

} // namespace

std::string ToUTF8(const zebcore::UTF16String& text)
{
    const zebcore::UTF8String bytes = zebcore::utility::UTF16to8(text);
    return {bytes.begin(), bytes.end()};
}

std::string Printable(const zebcore::UTF16String& text)
{
    zebcore::UTF16String visible = text.substr(0, text.find(u'\0'));
    for (char16_t& unit : visible)
    {
        unit = IsControl(unit) ? kReplacement : unit;
    }
    return std::string(Trimmed(ToUTF8(visible)));
}

zebcore::UTF16String FromUTF8(std::string_view text)
{
    return zebcore::utility::UTF8to16(zebcore::UTF8String(text.begin(), text.end()), nullptr, nullptr);
}

} // namespace zebhost
