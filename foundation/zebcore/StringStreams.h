#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"
#include "foundation/zebcore/TextOutputStream.h"

#include <concepts>
#include <istream>
#include <sstream>

namespace zebcore::utility
{

/// What the console gives to a command: derive from it to say where the text goes.
using UTF16OutputStream = TextOutputStream<char16_t>;

/// Collects 16-bit text.
class ZEB_EXPORT oUTF16StringStream : public UTF16OutputStream
{
public:
    const UTF16String& str() const { return mText; }

protected:
    void Write(std::u16string_view text) override;

private:
    UTF16String mText;
};

/// Collects 8-bit text.
class ZEB_EXPORT oUTF8StringStream : public TextOutputStream<char8_t>
{
public:
    const UTF8String& str() const { return mText; }

protected:
    void Write(std::u8string_view text) override;

private:
    UTF8String mText;
};

template <class T>
concept StreamReadableNumber = (std::integral<T> && !std::same_as<T, bool> && sizeof(T) > 1 &&
                                !std::same_as<T, char16_t> && !std::same_as<T, char32_t> &&
                                !std::same_as<T, wchar_t>) ||
                               std::floating_point<T>;

/// Reads numbers from 16-bit text as the standard's streams do in the classic locale: leading blanks are skipped, a
/// sign is taken, reading stops at the first unit that does not belong. Hexadecimal after std::hex. A read that fails
/// leaves the stream failed, and with it all later ones; the target then has no meaning. [one thread at a time]
class ZEB_EXPORT iUTF16StringStream
{
public:
    explicit iUTF16StringStream(const UTF16String& text);

    template <StreamReadableNumber T>
    iUTF16StringStream& operator>>(T& value)
    {
        mReader >> value;
        return *this;
    }
    iUTF16StringStream& operator>>(std::ios_base& (*manipulator)(std::ios_base&));

    bool fail() const { return mReader.fail(); }
    bool eof() const { return mReader.eof(); }
    explicit operator bool() const { return !fail(); }
    bool operator!() const { return fail(); }

private:
    std::istringstream mReader;
};

} // namespace zebcore::utility
