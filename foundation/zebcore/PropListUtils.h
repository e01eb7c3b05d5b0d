#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/File.h"
#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/StringTypes.h"

/// Property lists as text and files. The text is XML in UTF-8, described in docs/PROPERTY-LISTS.md. Whatever a list
/// holds, down to kMaxListDepth, comes back bit for bit: NaN payloads, line ends, zero units, lone surrogates,
/// ill-formed UTF-8.
namespace zebcore::proplist::utils
{

/// Sub-lists below sub-lists that the reader follows; text that is nested deeper counts as malformed.
inline constexpr unsigned int kMaxListDepth = 256;

/// Replaces the content of `list` by that of the file; with `merge`, adds to it instead, a key of the file replacing
/// an equal one. Returns false, with `list` empty (with `merge`: unchanged), if the file holds no well-formed
/// property list; that is traced in category "PropList". Throws file_exception if the file is missing or can't be
/// read. [any]
ZEB_EXPORT bool LoadPropList(const UTF16String& path, PropList& list, bool merge);

/// Writes the list to the file through SafeSave: the old file or the new one is there, whole, whatever happens. The
/// folder of preference files is made if the file belongs there and the folder is missing. Throws what SafeSave
/// throws: file_exception, and file_delete_exception if the system refuses to give up the old file. [any]
ZEB_EXPORT void SavePropList(filesupport::File& file, const PropList& list);

/// Replaces the content of `list` by that of the text. Returns false, with `list` empty, if the text is malformed;
/// that is traced in category "PropList". [any]
ZEB_EXPORT bool ReadPropList(const UTF8String& text, PropList& list);

/// Replaces `text` by what SavePropList would write. [any]
ZEB_EXPORT void WritePropList(UTF8String& text, const PropList& list);

} // namespace zebcore::proplist::utils
