#include "host/src/XAU/linux/src/ComponentBundle.h"

#include "foundation/zebcore/File.h"
#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/Trace.h"
#include "host/src/XAU/linux/src/CFStringObject.h"
#include "host/src/linux/SearchPath.h"

#include <algorithm>
#include <initializer_list>
#include <memory>
#include <optional>
#include <set>
#include <utility>

namespace zebaudiofilterhost::xau
{

namespace
{

using cf::ObjectPtr;

constexpr std::u16string_view kBundleExtension = u".component";

ObjectPtr ReadInfo(const UTF16String& bundle)
{
    UTF8String text;
    try
    {
        text = zebcore::utility::FileUtils::SimpleReadStringFromFile(bundle + u"/Contents/Info.plist");
    }
    catch (const zebcore::filesupport::file_exception&)
    {
        return nullptr;
    }
    const ObjectPtr data(
        CFDataCreate(nullptr, reinterpret_cast<const UInt8*>(text.data()), static_cast<CFIndex>(text.size())));
    const auto* bytes = static_cast<CFDataRef>(data.get());
    return ObjectPtr(CFPropertyListCreateWithData(nullptr, bytes, kCFPropertyListImmutable, nullptr, nullptr));
}

/// Null unless there is a value of that type.
template <typename T>
const T* Find(const CFOpaqueDictionary& dictionary, const char* key, CFTypeID type)
{
    const ObjectPtr name(CFStringCreateWithCString(nullptr, key, kCFStringEncodingUTF8));
    const void* value = CFDictionaryGetValue(&dictionary, name.get());
    return value && CFGetTypeID(value) == type ? static_cast<const T*>(value) : nullptr;
}

std::optional<OSType> FindCode(const CFOpaqueDictionary& dictionary, const char* key)
{
    constexpr std::size_t kCodeLength = 4;
    constexpr unsigned int kByte = 8;
    const auto* text = Find<CFOpaqueString>(dictionary, key, CFStringGetTypeID());
    std::string bytes;
    if (!text || !cf::Encode(text->mText, kCFStringEncodingISOLatin1, bytes) || bytes.size() != kCodeLength)
        return std::nullopt;
    OSType code = 0;
    for (const char byte : bytes)
        code = (code << kByte) | static_cast<unsigned char>(byte);
    return code;
}

// Nothing else tells why a unit of a bundle is missing.
void TraceLeftOut(const UTF16String& bundle, CFIndex index, const char* reason)
{
    ZEB_TRACE("ComponentBundle", bundle << ": entry " << index << " of \"AudioComponents\" is left out: " << reason);
}

// The key of the first value that is missing or of another form.
const char* FindFault(std::initializer_list<std::pair<const char*, bool>> values)
{
    const auto* const fault =
        std::find_if(values.begin(), values.end(), [](const auto& value) { return !value.second; });
    return fault == values.end() ? "" : fault->first;
}

std::optional<ComponentListing> ReadListing(const CFOpaqueDictionary& entry, const UTF16String& bundle, CFIndex index)
{
    const auto type = FindCode(entry, "type");
    const auto subType = FindCode(entry, "subtype");
    const auto manufacturer = FindCode(entry, "manufacturer");
    const auto* name = Find<CFOpaqueString>(entry, "name", CFStringGetTypeID());
    const auto* factory = Find<CFOpaqueString>(entry, "factoryFunction", CFStringGetTypeID());
    const bool hasFactory = factory != nullptr && !factory->mText.empty();
    if (!type || !subType || !manufacturer || !name || !hasFactory)
    {
        TraceLeftOut(bundle, index,
                     FindFault({{"type", type.has_value()},
                                {"subtype", subType.has_value()},
                                {"manufacturer", manufacturer.has_value()},
                                {"name", name != nullptr},
                                {"factoryFunction", hasFactory}}));
        return std::nullopt;
    }
    UInt32 version = 0;
    if (const auto* number = Find<CFOpaqueNumber>(entry, "version", CFNumberGetTypeID()))
        CFNumberGetValue(number, kCFNumberSInt32Type, &version);
    return ComponentListing{
        {*type, *subType, *manufacturer, 0, 0}, name->mText, version, bundle, cf::ToUTF8(factory)};
}

void WalkForBundles(const Dir& folder, std::set<UTF16String>& walked, std::vector<UTF16String>& bundles)
{
    if (!walked.insert(folder.FullPath()).second)
        return;
    const auto end = folder.EndSubdirs();
    for (auto item = folder.BeginSubdirs(false, nullptr, nullptr); item != end; ++item)
    {
        const Dir subFolder = *item;
        if (subFolder.FullPath().ends_with(kBundleExtension))
            bundles.push_back(subFolder.FullPath());
        else
            WalkForBundles(subFolder, walked, bundles);
    }
}

} // namespace

std::vector<ComponentListing> ReadComponentBundle(const UTF16String& path)
{
    const ObjectPtr info = ReadInfo(path);
    std::vector<ComponentListing> listings;
    if (!info || CFGetTypeID(info.get()) != CFDictionaryGetTypeID())
        return listings;
    const auto* components =
        Find<CFOpaqueArray>(*static_cast<CFDictionaryRef>(info.get()), "AudioComponents", CFArrayGetTypeID());
    for (CFIndex index = 0; components && index < CFArrayGetCount(components); ++index)
    {
        const void* entry = CFArrayGetValueAtIndex(components, index);
        if (CFGetTypeID(entry) != CFDictionaryGetTypeID())
            TraceLeftOut(path, index, "no dictionary");
        else if (auto listing = ReadListing(*static_cast<CFDictionaryRef>(entry), path, index))
            listings.push_back(std::move(*listing));
    }
    return listings;
}

std::vector<UTF16String> FindComponentBundles()
{
    std::vector<UTF16String> bundles;
    for (const Dir& bundle : GetSearchPath("AUDIO_COMPONENT_BUNDLES", {}))
        bundles.push_back(bundle.FullPath());
    std::set<UTF16String> walked;
    const auto folders =
        GetSearchPath("AUDIO_COMPONENT_PATH", {"~/.components", "/usr/local/lib/components", "/usr/lib/components"});
    for (const Dir& folder : folders)
        WalkForBundles(folder, walked, bundles);
    return bundles;
}

} // namespace zebaudiofilterhost::xau
