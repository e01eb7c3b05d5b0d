#pragma once

#include "foundation/zebcore/StringTypes.h"

#include <string_view>

// Text of any code units as XML text, and back. Reserved characters and blanks other than U+0020 become entities and
// character references, so that neither line-end nor attribute normalisation can change them. What XML can't hold
// goes through one escape of our own:
//
//     \uHHHH   a UTF-16 code unit: a control, a lone surrogate, U+FFFE or U+FFFF
//     \xHH     a byte of ill-formed UTF-8
//
// with lower-case digits. A backslash is itself, unless what follows it would make it an escape: it is "\u005c" then.
namespace zebcore::xml
{

void AppendXmlText(UTF8String& out, std::u16string_view text);
void AppendXmlText(UTF8String& out, std::u8string_view text);

// The inverse, for text that an XML parser has been over: it only undoes the escape.
void UnescapeXmlText(std::u8string_view parsed, UTF16String& out);
void UnescapeXmlText(std::u8string_view parsed, UTF8String& out);

} // namespace zebcore::xml
