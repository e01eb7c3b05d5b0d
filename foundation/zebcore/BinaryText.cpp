#include "foundation/zebcore/BinaryText.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace zebcore::utility
{

namespace
{

constexpr std::u8string_view kDigits = u8"ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
constexpr char8_t kPadding = u8'=';
constexpr std::uint32_t kNoDigit = 64;

// A group is three bytes, or four digits of six bits.
constexpr std::size_t kGroupBytes = 3;
constexpr std::size_t kGroupDigits = 4;

constexpr std::array<std::uint8_t, 256> MakeDigitValues()
{
    std::array<std::uint8_t, 256> values{};
    values.fill(static_cast<std::uint8_t>(kNoDigit));
    for (std::size_t i = 0; i < kDigits.size(); ++i)
        values[kDigits[i]] = static_cast<std::uint8_t>(i);
    return values;
}

constexpr std::array<std::uint8_t, 256> kDigitValues = MakeDigitValues();

void AppendGroup(UTF8String& text, const unsigned char* bytes, std::size_t count)
{
    std::uint32_t bits = 0;
    for (std::size_t i = 0; i < kGroupBytes; ++i)
        bits = bits << 8U | (i < count ? bytes[i] : 0U);
    for (std::size_t i = 0; i < kGroupDigits; ++i)
        text += i <= count ? kDigits[bits >> (18U - 6U * i) & 63U] : kPadding;
}

// `digits` are two to four, the group's padding not counted. False if one is no digit, or bits that no byte holds are
// set.
bool AppendBytes(std::vector<unsigned char>& data, std::u8string_view digits)
{
    std::uint32_t bits = 0;
    for (const char8_t digit : digits)
    {
        if (kDigitValues[digit] == kNoDigit)
            return false;
        bits = bits << 6U | kDigitValues[digit];
    }
    bits <<= 6U * (kGroupDigits - digits.size());
    const std::size_t count = digits.size() - 1;
    const std::array<unsigned char, kGroupBytes> bytes = {static_cast<unsigned char>(bits >> 16U & 255U),
                                                          static_cast<unsigned char>(bits >> 8U & 255U),
                                                          static_cast<unsigned char>(bits & 255U)};
    data.insert(data.end(), bytes.data(), bytes.data() + count);
    return (bits & (0xFFFFFFU >> (8U * count))) == 0;
}

bool Decode(std::u8string_view text, std::vector<unsigned char>& data)
{
    if (text.size() % kGroupDigits != 0)
        return false;
    data.reserve(text.size() / kGroupDigits * kGroupBytes);
    for (; !text.empty(); text.remove_prefix(kGroupDigits))
    {
        std::u8string_view digits = text.substr(0, kGroupDigits);
        if (text.size() == kGroupDigits) // only the last group may be padded
            digits = digits.substr(0, digits.find_last_not_of(kPadding) + 1);
        if (digits.size() < 2 || !AppendBytes(data, digits))
            return false;
    }
    return true;
}

} // namespace

bool EncodeBinaryDataToUTF8String(const unsigned char* data, unsigned long length, UTF8String& text)
{
    text.clear();
    if (data == nullptr && length != 0)
        return false;
    text.reserve((length + kGroupBytes - 1) / kGroupBytes * kGroupDigits);
    for (; length > kGroupBytes; data += kGroupBytes, length -= kGroupBytes)
        AppendGroup(text, data, kGroupBytes);
    if (length > 0)
        AppendGroup(text, data, length);
    return true;
}

bool DecodeBinaryDataFromUTF8String(const UTF8String& text, std::vector<unsigned char>& data)
{
    data.clear();
    if (Decode(text, data))
        return true;
    data.clear();
    return false;
}

} // namespace zebcore::utility
