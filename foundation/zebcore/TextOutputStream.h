#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <ostream>
#include <sstream>
#include <string>
#include <string_view>

namespace zebcore::utility
{

/// Whatever the standard's narrow streams print: numbers, characters, and the manipulators (std::hex, std::setw,
/// std::setfill, std::setprecision, std::showpoint and so on).
template <class T>
concept NarrowStreamable = requires(std::ostream& stream, const T& value)
{
    stream << value;
};

/// Output stream over text of one code unit type. Numbers look as the standard's streams write them in the classic
/// locale, whatever the global locales are: integers decimal unless std::hex was given, floats with 6 significant
/// digits unless a precision was given. A width holds for one output. Text of another encoding is converted; narrow
/// text is taken as ASCII into 16-bit text and byte by byte into 8-bit text. [one thread at a time]
template <class Unit>
class ZEB_EXPORT TextOutputStream
{
public:
    using View = std::basic_string_view<Unit>;

    TextOutputStream();
    TextOutputStream(const TextOutputStream&) = delete;
    TextOutputStream& operator=(const TextOutputStream&) = delete;
    virtual ~TextOutputStream();

    /// Hands on what has been written so far. Streams without a buffer have nothing to do.
    virtual void flush();

    TextOutputStream& operator<<(const UTF16String& text);
    TextOutputStream& operator<<(const UTF8String& text);
    TextOutputStream& operator<<(std::u16string_view text);
    TextOutputStream& operator<<(std::u8string_view text);
    /// Code-unit arrays end at their first zero unit; a null pointer writes nothing.
    TextOutputStream& operator<<(const char16_t* text);
    TextOutputStream& operator<<(const char8_t* text);
    TextOutputStream& operator<<(const unsigned char* text);
    TextOutputStream& operator<<(const char* text);
    TextOutputStream& operator<<(char16_t unit);
    TextOutputStream& operator<<(char8_t unit);
    TextOutputStream& operator<<(std::ios_base& (*manipulator)(std::ios_base&));
    TextOutputStream& operator<<(std::ostream& (*manipulator)(std::ostream&));

    template <NarrowStreamable T>
    TextOutputStream& operator<<(const T& value)
    {
        mFormatter << value;
        WriteFormatted();
        return *this;
    }

protected:
    /// Takes a piece of text; called once for each output.
    virtual void Write(View text) = 0;

private:
    void WriteFormatted();
    void WritePadded(View text);

    std::ostringstream mFormatter;
};

extern template class TextOutputStream<char16_t>;
extern template class TextOutputStream<char8_t>;

} // namespace zebcore::utility
