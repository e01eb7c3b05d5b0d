#include "host/src/XAU/src/XAUComponentID.h"

#include "foundation/zebcore/StringStreams.h"
#include "host/XAU/XAUTechnology.h"
#include "host/src/FilterIDPrefix.h"
#include "host/src/XAU/src/CFOwner.h"

namespace zebaudiofilterhost::xau
{

namespace
{

UTF16String Trim(const UTF16String& text)
{
    constexpr const char16_t* kBlanks = u" \t";
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == UTF16String::npos)
        return {};
    return text.substr(first, text.find_last_not_of(kBlanks) - first + 1);
}

} // namespace

UTF16String EncodeComponentID(const AudioComponentDescription& description)
{
    zebcore::utility::oUTF16StringStream stream;
    stream << description.componentType << " " << description.componentSubType << " "
           << description.componentManufacturer;
    return stream.str();
}

AudioComponentDescription DecodeComponentID(const UTF16String& id)
{
    zebcore::utility::iUTF16StringStream stream(WithoutTechnologyPrefix(id));
    AudioComponentDescription description = {};
    for (OSType* code :
         {&description.componentType, &description.componentSubType, &description.componentManufacturer})
    {
        unsigned int number = 0;
        *code = stream >> number ? number : 0;
    }
    return description;
}

AudioComponent FindComponentForDescription(const AudioComponentDescription& description)
{
    return AudioComponentFindNext(nullptr, &description);
}

void GetNameAndManufacturer(AudioComponent component, UTF16String& name, UTF16String& vendor)
{
    AudioComponentDescription description = {};
    CFStringRef text = nullptr;
    if (AudioComponentGetDescription(component, &description) != noErr ||
        AudioComponentCopyName(component, &text) != noErr)
        return;
    const CFOwner owner(text);
    const UTF16String fullName = MACtoZEB(text);
    const std::size_t colon = fullName.find(u':');
    const bool hasVendor = colon != UTF16String::npos && colon > 0;
    vendor = hasVendor ? Trim(fullName.substr(0, colon)) : UTF16String();
    name = Trim(hasVendor ? fullName.substr(colon + 1) : fullName);
}

Guid GetXAUFactoryGuid()
{
    static const Guid kXAUFactoryGuid(0x1ebfb632, 0x9f67, 0x4820, 0x99, 0x29, 0x2b, 0x1a, 0x91, 0x6b, 0x87, 0xdb);
    return kXAUFactoryGuid;
}

} // namespace zebaudiofilterhost::xau
