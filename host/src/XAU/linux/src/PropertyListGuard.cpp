#include "host/src/XAU/linux/src/PropertyListGuard.h"

#include <algorithm>
#include <optional>
#include <string_view>

namespace zebaudiofilterhost::xau::cf
{

namespace
{

using Bytes = std::span<const UInt8>;

constexpr std::string_view kMagic = "bplist";

// The end of the file says where the table of the objects' offsets is.
constexpr std::size_t kTrailerSize = 32;
constexpr std::size_t kOffsetSizeAt = 6;
constexpr std::size_t kObjectCountAt = 8;
constexpr std::size_t kTableOffsetAt = 24;

constexpr unsigned int kAsciiText = 5;
constexpr unsigned int kWideText = 6;
constexpr unsigned int kLongCount = 15; // a number with the count follows the marker

constexpr unsigned int kHalfByte = 4;
constexpr unsigned int kByte = 8;

// Nothing if the bytes end before.
std::optional<UInt64> ReadNumber(Bytes bytes, UInt64 at, std::size_t size)
{
    if (size > sizeof(UInt64) || bytes.size() < size || at > bytes.size() - size)
        return std::nullopt;
    UInt64 number = 0;
    for (const UInt8 byte : bytes.subspan(at, size))
        number = (number << kByte) | byte;
    return number;
}

struct TextPlace
{
    UInt64 at;
    UInt64 count; // characters
};

std::optional<TextPlace> FindText(Bytes bytes, UInt64 marker)
{
    const unsigned int count = bytes[marker] & kLongCount;
    if (count != kLongCount)
        return TextPlace{marker + 1, count};
    const auto numberMarker = ReadNumber(bytes, marker + 1, 1);
    if (!numberMarker)
        return std::nullopt;
    const std::size_t size = std::size_t{1} << (*numberMarker & kLongCount);
    const auto longCount = ReadNumber(bytes, marker + 2, size);
    return longCount ? std::optional(TextPlace{marker + 2 + size, *longCount}) : std::nullopt;
}

bool HasZero(Bytes bytes, UInt64 marker)
{
    const unsigned int kind = bytes[marker] >> kHalfByte;
    if (kind != kAsciiText && kind != kWideText)
        return false;
    const std::size_t size = kind == kWideText ? 2 : 1;
    const auto text = FindText(bytes, marker);
    if (!text || text->at > bytes.size() || text->count > (bytes.size() - text->at) / size)
        return false; // the parser refuses it
    for (UInt64 index = 0; index < text->count; ++index)
    {
        if (ReadNumber(bytes, text->at + index * size, size) == 0U)
            return true;
    }
    return false;
}

} // namespace

bool HasZeroInText(Bytes bytes)
{
    const bool isBinary =
        bytes.size() >= kMagic.size() + kTrailerSize && std::equal(kMagic.begin(), kMagic.end(), bytes.begin());
    if (!isBinary)
        return std::find(bytes.begin(), bytes.end(), 0) != bytes.end();
    const Bytes trailer = bytes.last(kTrailerSize);
    const std::size_t offsetSize = trailer[kOffsetSizeAt];
    const UInt64 count = ReadNumber(trailer, kObjectCountAt, sizeof(UInt64)).value_or(0);
    const UInt64 table = ReadNumber(trailer, kTableOffsetAt, sizeof(UInt64)).value_or(0);
    if (offsetSize == 0 || table > bytes.size())
        return false;
    const UInt64 room = (bytes.size() - table) / offsetSize;
    for (UInt64 index = 0; index < std::min(count, room); ++index)
    {
        const auto offset = ReadNumber(bytes, table + index * offsetSize, offsetSize);
        if (offset && *offset < bytes.size() && HasZero(bytes, *offset))
            return true;
    }
    return false;
}

} // namespace zebaudiofilterhost::xau::cf
