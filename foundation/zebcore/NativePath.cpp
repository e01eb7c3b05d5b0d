#include "foundation/zebcore/NativePath.h"

#include "foundation/zebcore/StringConversion.h"

#include <utf8.h>

#include <algorithm>

namespace zebcore::filesupport
{

namespace
{

constexpr char16_t kByteBase = 0xDC00;

// Bytes below 128 are never ill-formed, so nothing stands for them.
bool StandsForByte(char16_t unit)
{
    return unit >= kByteBase + 0x80 && unit <= kByteBase + 0xFF;
}

bool IsHighSurrogate(char16_t unit)
{
    return unit >= 0xD800 && unit < kByteBase;
}

} // namespace

std::string ToNativePath(const UTF16String& path)
{
    std::string native;
    const std::u16string_view all = path;
    std::size_t done = 0;
    for (std::size_t i = 0; i < all.size(); ++i)
    {
        if (IsHighSurrogate(all[i]))
            ++i; // skips its other half
        else if (StandsForByte(all[i]))
        {
            native += utility::NarrowFromUTF16(all.substr(done, i - done));
            native += static_cast<char>(all[i] - kByteBase);
            done = i + 1;
        }
    }
    return native += utility::NarrowFromUTF16(all.substr(done));
}

UTF16String FromNativePath(std::string_view path)
{
    UTF16String text;
    while (!path.empty())
    {
        const auto good = static_cast<std::size_t>(utf8::find_invalid(path.begin(), path.end()) - path.begin());
        text += utility::UTF16FromNarrow(path.substr(0, good));
        if (good < path.size())
            text += static_cast<char16_t>(kByteBase + static_cast<unsigned char>(path[good]));
        path.remove_prefix(std::min(good + 1, path.size()));
    }
    return text;
}

} // namespace zebcore::filesupport
