#include "foundation/zebcore/mac/MACtoZEB.h"

#include <vector>

namespace zebcore::utility
{

UTF16String MACtoZEB(CFStringRef text)
{
    if (text == nullptr)
        return {};
    const CFIndex length = CFStringGetLength(text);
    std::vector<UniChar> units(static_cast<std::size_t>(length));
    CFStringGetCharacters(text, CFRangeMake(0, length), units.data());
    return UTF16String(units.begin(), units.end());
}

} // namespace zebcore::utility
