#include "host/src/XAU/src/XAUPluginSearch.h"

#include "foundation/zebcore/DebugDatabase.h"
#include "host/BannedPluginManager.h"
#include "host/src/XAU/src/CFOwner.h"
#include "host/src/XAU/src/XAUAudioFilter.h"
#include "host/src/XAU/src/XAUComponentID.h"
#include "host/src/XAU/src/XAUScanContext.h"

#include <array>

namespace zebaudiofilterhost::xau
{

namespace
{

// In the order of the search. The mixer's type deliberately stands here twice: lists that applications have saved
// were made in this order, with mixers at both places.
constexpr std::array<OSType, 5> kSearchedTypes = {kAudioUnitType_Mixer, kAudioUnitType_MusicEffect,
                                                  kAudioUnitType_Effect, kAudioUnitType_Mixer, kAudioUnitType_Panner};

constexpr OSType kSystemManufacturer = 0x6170706C; // "appl"

// Of the system's own units only effects are of use here.
bool IsOffered(const AudioComponentDescription& description)
{
    const OSType type = description.componentType;
    return description.componentManufacturer != kSystemManufacturer || type == kAudioUnitType_Effect ||
           type == kAudioUnitType_MusicEffect || type == kAudioUnitType_OfflineEffect;
}

} // namespace

std::vector<PluginLocator> FindComponents(const AudioComponentDescription& description)
{
    std::vector<PluginLocator> locators;
    for (AudioComponent found = AudioComponentFindNext(nullptr, &description); found;
         found = AudioComponentFindNext(found, &description))
    {
        AudioComponentDescription of = {};
        if (AudioComponentGetDescription(found, &of) != noErr || !IsOffered(of))
            continue;
        const PluginLocator locator(kTechnologyAudioUnit, EncodeComponentID(of));
        if (!BannedPluginManager::GetInstance().IsPluginBanned(locator))
            locators.push_back(locator);
    }
    return locators;
}

std::vector<PluginLocator> GetPotentialPluginLocators()
{
    std::vector<PluginLocator> locators;
    if (!zebcore::debug::DebugDatabase::Instance().GetEntryAs<bool>(u8"EnableAUSupport", true))
        return locators;
    for (const OSType type : kSearchedTypes)
    {
        AudioComponentDescription description = {};
        description.componentType = type;
        const std::vector<PluginLocator> found = FindComponents(description);
        locators.insert(locators.end(), found.begin(), found.end());
    }
    return locators;
}

std::vector<UTF16String> GetDefaultAUPluginDirectories()
{
    return {u"N/A"};
}

UTF16String GetPathDisplayString(const UTF16String& id)
{
    AudioComponent component = FindComponentForDescription(DecodeComponentID(id));
    CFStringRef name = nullptr;
    if (!component || AudioComponentCopyName(component, &name) != noErr || !name)
        return id;
    const CFOwner owner(name);
    return MACtoZEB(name);
}

boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>& /*directories*/)
{
    return new XAUScanContext;
}

boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID)
{
    return XAUAudioFilter::Create(filterID);
}

} // namespace zebaudiofilterhost::xau
