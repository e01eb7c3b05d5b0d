#pragma once

#include <string>

namespace zebcore
{

/// UTF-16 text: the library's text type. Ordered lexicographically by code unit. May hold lone surrogates and zero
/// units, as names of plug-ins do.
using UTF16String = std::u16string;

/// UTF-8 text: keys of property lists and serialised text.
using UTF8String = std::u8string;

} // namespace zebcore
