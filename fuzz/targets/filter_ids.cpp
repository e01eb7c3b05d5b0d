// Filter IDs from presets and sessions, looked up in the catalogue.
#include "foundation/zebcore/Guid.h"
#include "foundation/zebcore/StringConversion.h"
#include "fuzz/support/Catalogue.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/src/FilterIDLookup.h"

#include "audiofilter/AudioFilter.h"
#include "utility/EffectUtils.h"

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;

const UTF16String kLegacyID = u"old";
const UTF16String kIDs[] = {u"2:1234", u"4:1234", u"4:56", u"2:7,Name", kPrivateFilterID, u""};

void FillIfEmpty()
{
    AudioFilterDescriptorManager& manager = AudioFilterDescriptorManager::GetInstance();
    if (manager.GetComponentDescriptorForID(kIDs[0]))
        return;
    EmptyCatalogue();
    for (const UTF16String& id : kIDs)
        manager.AddAudioFilterDescriptor(new AudioFilterDescriptor(
            PluginLocator(kTechnologyVST3, kPrivatePath), u"Name", u"Vendor", 1, kCategoryEffect, id, Guid(), false));
    manager.AddLegacyToCurrentIDMapping(kLegacyID, kPrivateFilterID);
}

bool IsFoundFor(const UTF16String& found, const UTF16String& id)
{
    return found == id || found == u"4:" + id || found == u"2:" + id ||
           (id == kLegacyID && found == kPrivateFilterID);
}

void Run(Bytes bytes)
{
    FillIfEmpty();
    const UTF16String id = zebcore::utility::UTF8to16(TextOf(bytes));
    const auto descriptor = FindDescriptorForFilterID(id);
    Expect(!descriptor || IsFoundFor(descriptor->GetUniqueID(), id), "an ID finds its own descriptor");
    for (const UTF16String& known : kIDs)
        Expect(id != known || (descriptor && descriptor->GetUniqueID() == known), "a known ID is found");
    Expect(utility::CreateAudioFilter(id) == nullptr, "a filter that nothing makes is null");

    const Guid guid = Guid::StringToGUID(id);
    Expect(Guid::StringToGUID(guid.AsString()) == guid, "the text of a GUID leads back to it");
}

const Target kTarget("filter_ids", Run);

} // namespace
