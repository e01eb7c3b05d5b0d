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

void EncodeFullGroups(const unsigned char* bytes, std::size_t groups, char8_t* digits)
{
    for (; groups > 0; --groups, bytes += kGroupBytes, digits += kGroupDigits)
    {
        const std::uint32_t bits = static_cast<std::uint32_t>(bytes[0]) << 16U |
                                   static_cast<std::uint32_t>(bytes[1]) << 8U | static_cast<std::uint32_t>(bytes[2]);
        digits[0] = kDigits[bits >> 18U];
        digits[1] = kDigits[bits >> 12U & 63U];
        digits[2] = kDigits[bits >> 6U & 63U];
        digits[3] = kDigits[bits & 63U];
    }
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

// Groups of four digits each. False if one is no digit.
bool DecodeFullGroups(std::u8string_view text, unsigned char* bytes)
{
    for (; !text.empty(); text.remove_prefix(kGroupDigits), bytes += kGroupBytes)
    {
        const std::uint32_t a = kDigitValues[text[0]];
        const std::uint32_t b = kDigitValues[text[1]];
        const std::uint32_t c = kDigitValues[text[2]];
        const std::uint32_t d = kDigitValues[text[3]];
        if (((a | b | c | d) & kNoDigit) != 0)
            return false;
        bytes[0] = static_cast<unsigned char>(a << 2U | b >> 4U);
        bytes[1] = static_cast<unsigned char>(b << 4U | c >> 2U);
        bytes[2] = static_cast<unsigned char>(c << 6U | d);
    }
    return true;
}

bool Decode(std::u8string_view text, std::vector<unsigned char>& data)
{
    if (text.empty() || text.size() % kGroupDigits != 0)
        return text.empty();
    const std::size_t full = text.size() - kGroupDigits; // only the last group may be padded
    data.reserve(text.size() / kGroupDigits * kGroupBytes);
    data.resize(full / kGroupDigits * kGroupBytes);
    const std::u8string_view last = text.substr(full);
    const std::u8string_view digits = last.substr(0, last.find_last_not_of(kPadding) + 1);
    return DecodeFullGroups(text.substr(0, full), data.data()) && digits.size() >= 2 && AppendBytes(data, digits);
}

} // namespace

bool EncodeBinaryDataToUTF8String(const unsigned char* data, unsigned long length, UTF8String& text)
{
    text.clear();
    if (data == nullptr && length != 0)
        return false;
    const std::size_t full = length / kGroupBytes;
    text.reserve((length + kGroupBytes - 1) / kGroupBytes * kGroupDigits);
    text.resize(full * kGroupDigits);
    EncodeFullGroups(data, full, text.data());
    data += full * kGroupBytes;
    length -= full * kGroupBytes;
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
