#include "foundation/zebcore/StringStreams.h"

#include "foundation/zebcore/Locale.h"

#include <algorithm>
#include <string>

namespace zebcore::utility
{

namespace
{

/// Numbers are ASCII; whatever else the text holds only has to end them.
std::string ToNarrowForNumbers(const UTF16String& text)
{
    constexpr char16_t kFirstBeyondAscii = 0x80;
    constexpr char kEndsAnyNumber = '?';

    std::string result(text.size(), kEndsAnyNumber);
    std::transform(text.begin(), text.end(), result.begin(),
                   [](char16_t unit) { return unit < kFirstBeyondAscii ? static_cast<char>(unit) : kEndsAnyNumber; });
    return result;
}

} // namespace

void oUTF16StringStream::Write(std::u16string_view text)
{
    mText += text;
}

void oUTF8StringStream::Write(std::u8string_view text)
{
    mText += text;
}

iUTF16StringStream::iUTF16StringStream(const UTF16String& text) : mReader(ToNarrowForNumbers(text))
{
    mReader.imbue(Locale::Default());
}

iUTF16StringStream& iUTF16StringStream::operator>>(std::ios_base& (*manipulator)(std::ios_base&))
{
    manipulator(mReader);
    return *this;
}

} // namespace zebcore::utility
