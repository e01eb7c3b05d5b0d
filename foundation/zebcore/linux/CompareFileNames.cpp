#include "foundation/zebcore/CompareFileNames.h"

namespace zebcore::filesupport
{

int CompareFileNames(const UTF16String& a, const UTF16String& b)
{
    return a.compare(b);
}

} // namespace zebcore::filesupport
