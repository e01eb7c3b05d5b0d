#include "foundation/zebcore/NumberToString.h"

#include "foundation/zebcore/StringConversion.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <limits>
#include <string_view>

namespace zebcore::utility
{

namespace
{

constexpr unsigned long kMostDecimals = 100;
/// Sign, digits of the largest double, point, decimals.
constexpr std::size_t kLongestText = 1 + std::numeric_limits<double>::max_exponent10 + 1 + 1 + kMostDecimals;

/// "-0.00" and "-nan" tell a reader nothing that "0.00" and "nan" do not.
std::string_view WithoutIdleSign(std::string_view text)
{
    const bool isIdle = text == "-nan" || text.find_first_not_of("-0.") == std::string_view::npos;
    return isIdle && text.starts_with('-') ? text.substr(1) : text;
}

} // namespace

UTF16String NumberToString(double value, unsigned long /*integerDigits*/, unsigned long decimals,
                           Flags<unsigned short> /*flags*/, int /*maximumLength*/)
{
    std::array<char, kLongestText> buffer{};
    const int precision = static_cast<int>(std::min(decimals, kMostDecimals));
    const auto* end =
        std::to_chars(buffer.data(), buffer.data() + buffer.size(), value, std::chars_format::fixed, precision).ptr;
    return AsciiToUTF16(WithoutIdleSign({buffer.data(), static_cast<std::size_t>(end - buffer.data())}));
}

} // namespace zebcore::utility
