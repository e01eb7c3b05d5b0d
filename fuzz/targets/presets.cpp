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

const std::vector<float> kParameters = {0.25F, 0.5F};
constexpr int kFrames = 4;
constexpr int kChannels = 4;

boost::intrusive_ptr<RecordingFilter> MakeFilter()
{
    InitializeMainThreadID();
    auto filter = zebaudiofilterhost::testing::MakeFilter({2}, {2});
    filter->mParameters = kParameters;
    filter->SetBlockSize(kFrames);
    filter->SetMainTargetBus(zebaudiofilterhost::testing::MakeBus(kChannels));
    filter->SetUseChannelMap(true);
    return filter;
}

bool AreParameters(const PresetData& preset)
{
    std::list<float> values;
    preset.GetParamList(values);
    return preset.GetPresetType() == PresetData::kPresetType_Params && values.size() == kParameters.size();
}

// The filter has no factory presets, and so calls each by an empty name: choosing one of those does nothing.
bool IsNothing(const PresetData& preset)
{
    return preset.GetPresetType() == PresetData::kPresetType_Factory && preset.GetFactoryIndex() >= 0 &&
           preset.GetFactoryPresetName().empty();
}

void CheckSettings(PropList& list)
{
    static const auto sFilter = MakeFilter();
    sFilter->mParameters = kParameters;
    sFilter->mParameterCalls.clear();
    const PresetData preset(list);
    const bool isOurs = preset.GetVersion() == sFilter->GetCurrentPresetVersion();
    const bool loaded = sFilter->LoadSettings(preset);
    Expect(loaded == (isOurs && (AreParameters(preset) || IsNothing(preset))),
           "a preset of another kind or length is refused");
    Expect(loaded || sFilter->mParameterCalls.empty(), "a preset that is refused changes nothing");
    if (!loaded)
        return;

    PropList savedList;
    PresetData saved(savedList);
    sFilter->SaveSettings(saved);
    Expect(sFilter->LoadSettings(saved), "settings that were saved can be loaded");
    PropList again;
    PresetData savedAgain(again);
    sFilter->SaveSettings(savedAgain);
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
    static zebaudiofilterhost::testing::Buffers in(kChannels, kFrames);
    static zebaudiofilterhost::testing::Buffers out(kChannels, kFrames);
    ChannelFlags flags;
    filter.mProcessCalls.clear();
    filter.Resume();
    filter.ProcessWithMapping(in.Pointers(), out.Pointers(), kFrames, ChannelFlags(), flags);
    filter.Suspend();
}

// The maps that come of settings must keep to the buffers.
void CheckChannelMaps(const PropList& list)
{
    static const auto sFilter = MakeFilter();
    static const ChannelMap sInputs = sFilter->GetChannelMap(AudioFilter::kDirection_Input);
    static const ChannelMap sOutputs = sFilter->GetChannelMap(AudioFilter::kDirection_Output);
    sFilter->LoadChannelMapSettings(&list);
    if (sFilter->GetChannelMap(AudioFilter::kDirection_Input) == sInputs &&
        sFilter->GetChannelMap(AudioFilter::kDirection_Output) == sOutputs)
        return;
    RunBlock(*sFilter);
    PropList saved;
    sFilter->SaveChannelMapSettings(&saved);
    Expect(sFilter->LoadChannelMapSettings(&saved), "channel maps that were saved can be loaded");
    RunBlock(*sFilter);
    sFilter->SetChannelMap(sInputs, AudioFilter::kDirection_Input);
    sFilter->SetChannelMap(sOutputs, AudioFilter::kDirection_Output);
}

void Run(Bytes bytes)
{
    PropList list;
    if (!zebcore::proplist::utils::ReadPropList(TextOf(bytes), list))
        return;
    CheckChannelMaps(list);
    CheckSettings(list);
    CheckViews(list);
}

const Target kTarget("presets", Run);

} // namespace
