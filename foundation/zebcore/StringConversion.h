#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace zebcore::utility
{

/// What UTF8to16 found in its input.
enum UnicodeErrorCode
{
    kUnicodeError_None = 0,
    kUnicodeError_IllFormed = 1,
};

// None of the conversions fails or throws on any input: what is ill-formed becomes U+FFFD.

/// Widens each byte, so that bytes above 127 become U+0080 to U+00FF. Length 0 gives an empty string, whatever the
/// pointer. [any]
ZEB_EXPORT UTF16String AsciiToUTF16(const char* text, std::size_t length);
ZEB_EXPORT UTF16String AsciiToUTF16(std::string_view text);

/// A lone surrogate becomes U+FFFD. [any]
ZEB_EXPORT UTF8String UTF16to8(std::u16string_view text);

/// errorCode: may be null; receives whether anything was replaced. errorPosition: may be null; receives the index of
/// the first ill-formed byte, or the length of the text when there is none. [any]
ZEB_EXPORT UTF16String UTF8to16(std::u8string_view text, UnicodeErrorCode* errorCode = nullptr,
                                unsigned long* errorPosition = nullptr);

/// The same bytes under the other type: for interfaces that take their UTF-8 as char. [any]
ZEB_EXPORT std::string NarrowFromUTF8(std::u8string_view text);
ZEB_EXPORT UTF8String UTF8FromNarrow(std::string_view text);

/// UTF16to8 and UTF8to16 for UTF-8 that travels as char: paths, plug-in texts, output. [any]
ZEB_EXPORT std::string NarrowFromUTF16(std::u16string_view text);
ZEB_EXPORT UTF16String UTF16FromNarrow(std::string_view utf8);

} // namespace zebcore::utility
