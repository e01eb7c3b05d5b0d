// A preset file, of whatever kind it says it is, and the channel maps that an application keeps beside it.
#include "audiofilter/PresetData.h"
#include "audiofilter/PresetList.h"
#include "foundation/zebcore/PropListUtils.h"
#include "fuzz/support/ListText.h"
#include "fuzz/support/ScratchFile.h"
#include "fuzz/support/Target.h"
#include "tests/audiofilter/RecordingFilter.h"
#include "utility/ThreadUtils.h"

#include <list>
#include <set>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost;
using zebaudiofilterhost::testing::RecordingFilter;

constexpr int kFrames = 4;
constexpr int kChannels = 4;

boost::intrusive_ptr<RecordingFilter> MakeFilter()
{
    InitializeMainThreadID();
    auto filter = zebaudiofilterhost::testing::MakeFilter({2}, {2});
    filter->mParameters = {0.25F, 0.5F};
    filter->SetBlockSize(kFrames);
    filter->SetMainTargetBus(zebaudiofilterhost::testing::MakeBus(kChannels));
    filter->SetUseChannelMap(true);
    return filter;
}

void CheckSettings(PropList& list)
{
    const auto filter = MakeFilter();
    const std::vector<float> before = filter->mParameters;
    const PresetData preset(list);
    const bool isOurs = preset.GetVersion() == filter->GetCurrentPresetVersion() &&
                        preset.GetPresetType() == PresetData::kPresetType_Params;
    std::list<float> values;
    preset.GetParamList(values);
    const bool loaded = filter->LoadSettings(preset);
    Expect(loaded == (isOurs && values.size() == before.size()), "a preset of another kind or length is refused");
    Expect(loaded || filter->mParameterCalls.empty(), "a preset that is refused changes nothing");

    PropList savedList;
    PresetData saved(savedList);
    filter->SaveSettings(saved);
    Expect(filter->LoadSettings(saved), "settings that were saved can be loaded");
    PropList again;
    PresetData savedAgain(again);
    filter->SaveSettings(savedAgain);
    Expect(ListText(savedList) == ListText(again), "settings come back bit for bit");
}

void CheckViews(PropList& list)
{
    const PresetData preset(list);
    std::vector<unsigned char> chunk;
    Expect(preset.GetChunkData(chunk) || chunk.empty(), "a chunk that can't be decoded gives no bytes");
    PropList copied;
    PresetData copy(copied);
    copy.SetDataFromExistingPreset(preset);
    Expect(ListText(copied) == ListText(list), "a copy of a preset is equal");
    Expect((copy == preset) == (preset == copy), "presets are equal both ways");

    const boost::intrusive_ptr<PresetList> presets(new PresetList(list));
    std::set<UTF16String> names;
    presets->GetPresetNames(names);
    for (const UTF16String& name : names)
        presets->GetPreset(name);
}

void RunBlock(RecordingFilter& filter)
{
    filter.Resume();
    zebaudiofilterhost::testing::Buffers in(kChannels, kFrames);
    zebaudiofilterhost::testing::Buffers out(kChannels, kFrames);
    ChannelFlags flags;
    filter.ProcessWithMapping(in.Pointers(), out.Pointers(), kFrames, ChannelFlags(), flags);
    filter.Suspend();
}

// The maps that come of settings must keep to the buffers.
void CheckChannelMaps(const PropList& list)
{
    const auto filter = MakeFilter();
    filter->LoadChannelMapSettings(&list);
    RunBlock(*filter);
    PropList saved;
    filter->SaveChannelMapSettings(&saved);
    Expect(filter->LoadChannelMapSettings(&saved), "channel maps that were saved can be loaded");
    RunBlock(*filter);
}

void Run(Bytes bytes)
{
    PropList list;
    zebcore::proplist::utils::ReadPropList(TextOf(bytes), list);
    CheckChannelMaps(list);
    CheckSettings(list);
    CheckViews(list);
}

const Target kTarget("presets", Run);

} // namespace
