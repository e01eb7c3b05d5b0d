#include "foundation/zebcore/CompareFileNames.h"

#include <functional>

namespace zebcore::filesupport
{

int CompareFileNames(const UTF16String& a, const UTF16String& b)
{
    return a.compare(b);
}

std::size_t HashFileName(const UTF16String& path)
{
    return std::hash<UTF16String>()(path);
}

} // namespace zebcore::filesupport
