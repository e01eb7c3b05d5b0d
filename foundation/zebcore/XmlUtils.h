#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

namespace zebcore::xml::utils
{

/// Replaces `out` by `in` as it stands in a serialised property list, so that it can be searched for there:
/// characters reserved in XML as entities, line ends and tabs as character references, and code units that XML can't
/// hold in the form
/// "\u0000". Ordinary paths come out as one run, without any change to blanks and non-Latin letters. [any]
ZEB_EXPORT void EncodeReservedCharacters(const UTF16String& in, UTF16String& out);

} // namespace zebcore::xml::utils
