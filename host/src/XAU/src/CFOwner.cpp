#include "host/src/XAU/src/CFOwner.h"

namespace zebaudiofilterhost::xau
{

UTF16String MACtoZEB(CFStringRef text)
{
    if (!text)
        return {};
    const CFIndex length = CFStringGetLength(text);
    UTF16String units(static_cast<std::size_t>(length), u'\0');
    CFStringGetCharacters(text, CFRangeMake(0, length), reinterpret_cast<UniChar*>(units.data()));
    return units;
}

} // namespace zebaudiofilterhost::xau
