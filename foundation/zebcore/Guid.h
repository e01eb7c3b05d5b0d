#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <array>
#include <compare>
#include <cstdint>

namespace zebcore::utility
{

/// 128-bit identifier. The default is all zero. The order is only there for maps.
class ZEB_EXPORT Guid
{
public:
    constexpr Guid() = default;
    constexpr Guid(std::uint32_t data1, std::uint16_t data2, std::uint16_t data3, std::uint8_t b0, std::uint8_t b1,
                   std::uint8_t b2, std::uint8_t b3, std::uint8_t b4, std::uint8_t b5, std::uint8_t b6,
                   std::uint8_t b7)
        : mData1(data1), mData2(data2), mData3(data3), mBytes{b0, b1, b2, b3, b4, b5, b6, b7}
    {
    }

    /// A new random identifier. [any]
    static Guid CreateUnique();
    /// Inverse of AsString; capital letters are taken too. Any other text gives all zero. [any]
    static Guid StringToGUID(const UTF16String& text);

    /// 8-4-4-4-12 hexadecimal digits in lower case, such as "eb0fed8b-7841-4f2b-a655-d8cddea9f465". [any]
    UTF16String AsString() const;

    constexpr bool operator==(const Guid&) const = default;
    constexpr std::strong_ordering operator<=>(const Guid&) const = default; // NOLINT(modernize-use-nullptr)

private:
    std::uint32_t mData1 = 0;
    std::uint16_t mData2 = 0;
    std::uint16_t mData3 = 0;
    std::array<std::uint8_t, 8> mBytes{};
};

} // namespace zebcore::utility
