#include "foundation/zebcore/Guid.h"

#include <algorithm>
#include <cstddef>
#include <optional>
#include <random>
#include <string_view>

namespace zebcore::utility
{

namespace
{

constexpr std::u16string_view kForm = u"00000000-0000-0000-0000-000000000000";

std::optional<unsigned int> DigitValue(char16_t unit)
{
    if (unit >= u'0' && unit <= u'9')
        return static_cast<unsigned int>(unit - u'0');
    if (unit >= u'a' && unit <= u'f')
        return static_cast<unsigned int>(unit - u'a' + 10);
    if (unit >= u'A' && unit <= u'F')
        return static_cast<unsigned int>(unit - u'A' + 10);
    return std::nullopt;
}

bool HasForm(std::u16string_view text)
{
    return std::equal(text.begin(), text.end(), kForm.begin(), kForm.end(),
                      [](char16_t unit, char16_t form)
                      { return form == u'-' ? unit == u'-' : DigitValue(unit).has_value(); });
}

std::uint32_t HexValue(std::u16string_view digits)
{
    std::uint32_t value = 0;
    for (const char16_t digit : digits)
        value = (value << 4) | DigitValue(digit).value_or(0);
    return value;
}

void AppendHex(UTF16String& text, std::uint32_t value, unsigned int digits)
{
    constexpr std::u16string_view kDigits = u"0123456789abcdef";
    while (digits-- > 0)
        text += kDigits[(value >> (4 * digits)) & 15U];
}

} // namespace

Guid Guid::CreateUnique()
{
    std::random_device random;
    Guid result;
    result.mData1 = random();
    result.mData2 = static_cast<std::uint16_t>(random());
    // The two marks of a random identifier: version 4, variant 1.
    result.mData3 = static_cast<std::uint16_t>((random() & 0x0FFF) | 0x4000);
    std::generate(result.mBytes.begin(), result.mBytes.end(), [&] { return static_cast<std::uint8_t>(random()); });
    result.mBytes[0] = static_cast<std::uint8_t>((result.mBytes[0] & 0x3F) | 0x80);
    return result;
}

Guid Guid::StringToGUID(const UTF16String& text)
{
    Guid result;
    if (!HasForm(text))
        return result;

    const std::u16string_view view = text;
    result.mData1 = HexValue(view.substr(0, 8));
    result.mData2 = static_cast<std::uint16_t>(HexValue(view.substr(9, 4)));
    result.mData3 = static_cast<std::uint16_t>(HexValue(view.substr(14, 4)));
    constexpr std::array<std::size_t, 8> kBytePositions{19, 21, 24, 26, 28, 30, 32, 34};
    for (std::size_t i = 0; i < kBytePositions.size(); ++i)
        result.mBytes[i] = static_cast<std::uint8_t>(HexValue(view.substr(kBytePositions[i], 2)));
    return result;
}

UTF16String Guid::AsString() const
{
    UTF16String text;
    text.reserve(kForm.size());
    AppendHex(text, mData1, 8);
    AppendHex(text += u'-', mData2, 4);
    AppendHex(text += u'-', mData3, 4);
    text += u'-';
    for (std::size_t i = 0; i < mBytes.size(); ++i)
    {
        if (i == 2)
            text += u'-';
        AppendHex(text, mBytes[i], 2);
    }
    return text;
}

} // namespace zebcore::utility
