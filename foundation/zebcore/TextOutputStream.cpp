#include "foundation/zebcore/TextOutputStream.h"

#include "foundation/zebcore/Locale.h"
#include "foundation/zebcore/StringConversion.h"

#include <algorithm>
#include <type_traits>

namespace zebcore::utility
{

namespace
{

template <class Unit>
std::basic_string<Unit> FromNarrow(std::string_view text)
{
    if constexpr (std::is_same_v<Unit, char16_t>)
        return AsciiToUTF16(text);
    else
        return UTF8FromNarrow(text);
}

} // namespace

template <class Unit>
TextOutputStream<Unit>::TextOutputStream()
{
    mFormatter.imbue(Locale::Default());
}

template <class Unit>
TextOutputStream<Unit>::~TextOutputStream() = default;

template <class Unit>
void TextOutputStream<Unit>::flush()
{
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(const UTF16String& text)
{
    return *this << std::u16string_view(text);
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(const UTF8String& text)
{
    return *this << std::u8string_view(text);
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(std::u16string_view text)
{
    if constexpr (std::is_same_v<Unit, char16_t>)
        WritePadded(text);
    else
        WritePadded(UTF16to8(text));
    return *this;
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(std::u8string_view text)
{
    if constexpr (std::is_same_v<Unit, char8_t>)
        WritePadded(text);
    else
        WritePadded(UTF8to16(text));
    return *this;
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(const char16_t* text)
{
    return *this << (text == nullptr ? std::u16string_view() : std::u16string_view(text));
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(const char8_t* text)
{
    return *this << (text == nullptr ? std::u8string_view() : std::u8string_view(text));
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(const unsigned char* text)
{
    return *this << reinterpret_cast<const char*>(text);
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(const char* text)
{
    WritePadded(FromNarrow<Unit>(text == nullptr ? std::string_view() : std::string_view(text)));
    return *this;
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(char16_t unit)
{
    return *this << std::u16string_view(&unit, 1);
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(char8_t unit)
{
    // One unit of 8-bit text need not be text by itself, so it is not converted but widened.
    WritePadded(FromNarrow<Unit>(std::string(1, static_cast<char>(unit))));
    return *this;
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(std::ios_base& (*manipulator)(std::ios_base&))
{
    manipulator(mFormatter);
    return *this;
}

template <class Unit>
TextOutputStream<Unit>& TextOutputStream<Unit>::operator<<(std::ostream& (*manipulator)(std::ostream&))
{
    manipulator(mFormatter);
    WriteFormatted();
    return *this;
}

template <class Unit>
void TextOutputStream<Unit>::WriteFormatted()
{
    const std::basic_string<Unit> text = FromNarrow<Unit>(mFormatter.view());
    mFormatter.clear(); // Null text, for one, leaves it failed.
    mFormatter.str(std::string());
    if (!text.empty())
        Write(text);
}

template <class Unit>
void TextOutputStream<Unit>::WritePadded(View text)
{
    const auto width = static_cast<std::size_t>(std::max<std::streamsize>(mFormatter.width(0), 0));
    if (width <= text.size())
        return Write(text);
    const std::basic_string<Unit> fill(width - text.size(), static_cast<Unit>(mFormatter.fill()));
    const bool left = (mFormatter.flags() & std::ios_base::adjustfield) == std::ios_base::left;
    Write(left ? std::basic_string<Unit>(text) + fill : fill + std::basic_string<Unit>(text));
}

template class TextOutputStream<char16_t>;
template class TextOutputStream<char8_t>;

} // namespace zebcore::utility
