#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <vector>

/// Bytes as text, so that a plug-in's chunk can stand in a property list. The encoding is base64 of RFC 4648 section
/// 4, with padding and without line breaks. Presets are written in it: it never changes.
namespace zebcore::utility
{

/// Replaces `text`. Returns false, with `text` empty, if `data` is null and `length` is not 0. [any]
ZEB_EXPORT bool EncodeBinaryDataToUTF8String(const unsigned char* data, unsigned long length, UTF8String& text);

/// Replaces `data`. Returns false, with `data` empty, for a text that the encoder would not have written. [any]
ZEB_EXPORT bool DecodeBinaryDataFromUTF8String(const UTF8String& text, std::vector<unsigned char>& data);

} // namespace zebcore::utility
