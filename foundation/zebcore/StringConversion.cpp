#include "foundation/zebcore/StringConversion.h"

#include <utf8.h>

#include <algorithm>
#include <iterator>

namespace zebcore::utility
{

namespace
{

constexpr char32_t kReplacementCharacter = 0xFFFD;
constexpr char32_t kFirstSurrogate = 0xD800;
constexpr char32_t kFirstLowSurrogate = 0xDC00;
constexpr char32_t kFirstBeyondSurrogates = 0xE000;
constexpr char32_t kFirstSupplementary = 0x10000;

bool IsSurrogate(char32_t unit)
{
    return unit >= kFirstSurrogate && unit < kFirstBeyondSurrogates;
}

bool IsPair(char16_t high, char16_t low)
{
    return high >= kFirstSurrogate && high < kFirstLowSurrogate && low >= kFirstLowSurrogate &&
           low < kFirstBeyondSurrogates;
}

/// Takes one code point off the front of the text, which is not empty.
char32_t TakeCodePoint(std::u16string_view& text)
{
    const char16_t first = text[0];
    if (text.size() > 1 && IsPair(first, text[1]))
    {
        const char32_t high = first - kFirstSurrogate;
        const char32_t low = text[1] - kFirstLowSurrogate;
        text.remove_prefix(2);
        return kFirstSupplementary + (high << 10) + low;
    }
    text.remove_prefix(1);
    return IsSurrogate(first) ? kReplacementCharacter : first;
}

UTF16String ToUTF16(std::string_view wellFormed)
{
    UTF16String result;
    result.reserve(wellFormed.size());
    utf8::unchecked::utf8to16(wellFormed.begin(), wellFormed.end(), std::back_inserter(result));
    return result;
}

template <class String>
String FromUTF16(std::u16string_view text)
{
    String result;
    result.reserve(text.size());
    while (!text.empty())
        utf8::unchecked::append(TakeCodePoint(text), std::back_inserter(result));
    return result;
}

// Most text is: names, paths, numbers.
bool IsAscii(std::string_view text)
{
    constexpr auto kOther = static_cast<unsigned char>(0x80);
    unsigned char seen = 0;
    for (const char byte : text) // Without a way out, which lets the compiler take many bytes at a time
        seen |= static_cast<unsigned char>(byte);
    return seen < kOther;
}

std::string_view AsNarrow(std::u8string_view text)
{
    return {reinterpret_cast<const char*>(text.data()), text.size()};
}

} // namespace

UTF16String AsciiToUTF16(const char* text, std::size_t length)
{
    return AsciiToUTF16(length == 0 ? std::string_view() : std::string_view(text, length));
}

UTF16String AsciiToUTF16(std::string_view text)
{
    UTF16String result(text.size(), u'\0');
    std::transform(text.begin(), text.end(), result.begin(),
                   [](char byte) { return static_cast<char16_t>(static_cast<unsigned char>(byte)); });
    return result;
}

UTF8String UTF16to8(std::u16string_view text)
{
    return FromUTF16<UTF8String>(text);
}

UTF16String UTF8to16(std::u8string_view text, UnicodeErrorCode* errorCode, unsigned long* errorPosition)
{
    const std::string_view narrow = AsNarrow(text);
    const char* end = narrow.data() + narrow.size();
    const char* firstIllFormed = IsAscii(narrow) ? end : utf8::find_invalid(narrow.data(), end);
    if (errorCode != nullptr)
        *errorCode = firstIllFormed == end ? kUnicodeError_None : kUnicodeError_IllFormed;
    if (errorPosition != nullptr)
        *errorPosition = static_cast<unsigned long>(firstIllFormed - narrow.data());
    return UTF16FromNarrow(narrow);
}

std::string NarrowFromUTF8(std::u8string_view text)
{
    return std::string(AsNarrow(text));
}

UTF8String UTF8FromNarrow(std::string_view text)
{
    return {reinterpret_cast<const char8_t*>(text.data()), text.size()};
}

std::string NarrowFromUTF16(std::u16string_view text)
{
    return FromUTF16<std::string>(text);
}

UTF16String UTF16FromNarrow(std::string_view utf8)
{
    if (IsAscii(utf8))
        return AsciiToUTF16(utf8);
    if (utf8::is_valid(utf8.begin(), utf8.end()))
        return ToUTF16(utf8);
    std::string repaired;
    utf8::replace_invalid(utf8.begin(), utf8.end(), std::back_inserter(repaired), kReplacementCharacter);
    return ToUTF16(repaired);
}

} // namespace zebcore::utility
