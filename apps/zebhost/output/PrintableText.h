#pragma once

#include <foundation/zebcore/StringTypes.h>

#include <string>
#include <string_view>

namespace zebhost
{

// Text that came from a plug-in, as UTF-8 that a terminal and a JSON reader can take: cut at the first zero unit
// (names come padded with them), without blanks at the ends, control characters and lone surrogates as U+FFFD.
std::string Printable(const zebcore::UTF16String& text);

// UTF-8 of a path or an ID, unit for unit.
std::string ToUTF8(const zebcore::UTF16String& text);

// What stands in a command line or a file of ours.
zebcore::UTF16String FromUTF8(std::string_view text);

} // namespace zebhost
