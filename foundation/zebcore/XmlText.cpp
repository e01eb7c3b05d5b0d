#include "foundation/zebcore/internal/XmlText.h"

#include "foundation/zebcore/StringConversion.h"

#include <utf8.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <optional>

namespace zebcore::xml
{

namespace
{

struct EscapeForm
{
    char mLetter;
    std::size_t mDigits;
};

constexpr EscapeForm kUnitForm{'u', 4};
constexpr EscapeForm kByteForm{'x', 2};
constexpr std::size_t kPrefixLength = 2; // the backslash and the letter

template <typename Unit>
std::optional<std::uint32_t> HexDigit(Unit unit)
{
    if (unit >= Unit{'0'} && unit <= Unit{'9'})
        return static_cast<std::uint32_t>(unit - Unit{'0'});
    if (unit >= Unit{'a'} && unit <= Unit{'f'})
        return static_cast<std::uint32_t>(unit - Unit{'a'}) + 10;
    return std::nullopt;
}

template <typename Unit>
std::optional<std::uint32_t> ParseEscape(std::basic_string_view<Unit> text, EscapeForm form)
{
    if (text.size() < kPrefixLength + form.mDigits || text[0] != Unit{'\\'} ||
        text[1] != static_cast<Unit>(form.mLetter))
        return std::nullopt;
    std::uint32_t value = 0;
    for (const Unit unit : text.substr(kPrefixLength, form.mDigits))
    {
        const std::optional<std::uint32_t> digit = HexDigit(unit);
        if (!digit)
            return std::nullopt;
        value = value * 16 + *digit;
    }
    return value;
}

template <typename Unit>
bool BeginsEscape(std::basic_string_view<Unit> text)
{
    return ParseEscape(text, kUnitForm) || ParseEscape(text, kByteForm);
}

void AppendEscape(UTF8String& out, EscapeForm form, std::uint32_t value)
{
    static constexpr char8_t kDigits[] = u8"0123456789abcdef";
    out += u8'\\';
    out += static_cast<char8_t>(form.mLetter);
    for (std::size_t shift = form.mDigits; shift-- > 0;)
        out += kDigits[(value >> (4 * shift)) & 15U];
}

// Null for a character that stands for itself.
const char8_t* Reference(char32_t character)
{
    switch (character)
    {
    case U'&':
        return u8"&amp;";
    case U'<':
        return u8"&lt;";
    case U'>':
        return u8"&gt;";
    case U'"':
        return u8"&quot;";
    case U'\'':
        return u8"&apos;";
    case U'\t':
        return u8"&#9;";
    case U'\n':
        return u8"&#10;";
    case U'\r':
        return u8"&#13;";
    default:
        return nullptr;
    }
}

bool CanStandInXml(char32_t character)
{
    return character >= U' ' && character != U'\xFFFE' && character != U'\xFFFF';
}

void AppendCharacter(UTF8String& out, char32_t character)
{
    if (const char8_t* const reference = Reference(character))
        out += reference;
    else if (CanStandInXml(character))
        utf8::unchecked::append(character, std::back_inserter(out));
    else
        AppendEscape(out, kUnitForm, character);
}

// What goes into the text as it is: printable ASCII without the reserved characters and the backslash.
constexpr std::array<bool, 128> MakePlainTable()
{
    std::array<bool, 128> plain{};
    for (char32_t character = U' '; character < 0x7F; ++character)
        plain[character] = character != U'&' && character != U'<' && character != U'>' && character != U'"' &&
                           character != U'\'' && character != U'\\';
    return plain;
}

constexpr std::array<bool, 128> kPlain = MakePlainTable();

// A look into a table: a chunk of megabytes goes through here.
template <typename Unit>
constexpr bool IsPlain(Unit unit)
{
    return unit < kPlain.size() && kPlain[unit];
}

// Appends the plain beginning of the text, which is nearly always all of it, and returns its length.
template <typename Unit>
std::size_t AppendPlain(UTF8String& out, std::basic_string_view<Unit> text)
{
    const auto end = std::find_if_not(text.begin(), text.end(), IsPlain<Unit>);
    const auto length = static_cast<std::size_t>(end - text.begin());
    const std::size_t before = out.size();
    if (out.capacity() - before < length) // Room for what follows too: a chunk of megabytes is not to be moved again
        out.reserve(before + length + length / 8);
    out.resize(before + length);
    std::transform(text.begin(), end, out.begin() + static_cast<std::ptrdiff_t>(before),
                   [](Unit unit) { return static_cast<char8_t>(unit); });
    return length;
}

constexpr bool IsHighSurrogate(char32_t unit)
{
    return unit >= 0xD800 && unit < 0xDC00;
}

constexpr bool IsLowSurrogate(char32_t unit)
{
    return unit >= 0xDC00 && unit < 0xE000;
}

void AppendUnit(UTF16String& out, std::uint32_t unit)
{
    out += static_cast<char16_t>(unit);
}

void AppendByte(UTF16String& out, std::uint32_t byte)
{
    out += static_cast<char16_t>(byte);
}

void AppendUnit(UTF8String& out, std::uint32_t unit)
{
    utf8::unchecked::append(unit, std::back_inserter(out));
}

void AppendByte(UTF8String& out, std::uint32_t byte)
{
    out += static_cast<char8_t>(byte);
}

void AppendRun(UTF16String& out, std::u8string_view run)
{
    if (out.empty())
        out = utility::UTF8to16(run);
    else
        out += utility::UTF8to16(run);
}

void AppendRun(UTF8String& out, std::u8string_view run)
{
    out += run;
}

template <typename String>
void Unescape(std::u8string_view parsed, String& out)
{
    out.clear();
    std::size_t done = 0;
    for (std::size_t at = parsed.find(u8'\\'); at != std::u8string_view::npos;
         at = parsed.find(u8'\\', std::max(at + 1, done)))
    {
        const std::u8string_view rest = parsed.substr(at);
        const std::optional<std::uint32_t> unit = ParseEscape(rest, kUnitForm);
        const std::optional<std::uint32_t> byte = unit ? std::nullopt : ParseEscape(rest, kByteForm);
        if (!unit && !byte)
            continue;
        AppendRun(out, parsed.substr(done, at - done));
        if (unit)
            AppendUnit(out, *unit);
        else
            AppendByte(out, *byte);
        done = at + kPrefixLength + (unit ? kUnitForm.mDigits : kByteForm.mDigits);
    }
    AppendRun(out, parsed.substr(done));
}

// The text holds well-formed UTF-8 only.
void AppendWellFormed(UTF8String& out, std::u8string_view all, std::size_t begin, std::size_t end)
{
    for (const char8_t* at = all.data() + begin; at != all.data() + end;)
    {
        if (*at == u8'\\' && BeginsEscape(all.substr(static_cast<std::size_t>(at - all.data()))))
        {
            AppendEscape(out, kUnitForm, U'\\');
            ++at;
        }
        else
            AppendCharacter(out, utf8::unchecked::next(at));
    }
}

} // namespace

void AppendXmlText(UTF8String& out, std::u16string_view text)
{
    for (std::size_t i = AppendPlain(out, text); i < text.size(); ++i)
    {
        const char32_t unit = text[i];
        if (IsHighSurrogate(unit) && i + 1 < text.size() && IsLowSurrogate(text[i + 1]))
            AppendCharacter(out, 0x10000 + ((unit - 0xD800) << 10) + (text[++i] - U'\xDC00'));
        else if (IsHighSurrogate(unit) || IsLowSurrogate(unit) || (unit == U'\\' && BeginsEscape(text.substr(i))))
            AppendEscape(out, kUnitForm, unit);
        else
            AppendCharacter(out, unit);
    }
}

void AppendXmlText(UTF8String& out, std::u8string_view text)
{
    for (std::size_t done = AppendPlain(out, text); done < text.size();)
    {
        const auto* const bad = utf8::find_invalid(text.data() + done, text.data() + text.size());
        const auto good = static_cast<std::size_t>(bad - text.data());
        AppendWellFormed(out, text, done, good);
        if (good < text.size())
            AppendEscape(out, kByteForm, *bad);
        done = good + 1;
    }
}

void UnescapeXmlText(std::u8string_view parsed, UTF16String& out)
{
    Unescape(parsed, out);
}

void UnescapeXmlText(std::u8string_view parsed, UTF8String& out)
{
    Unescape(parsed, out);
}

} // namespace zebcore::xml
