#include "host/AudioFilterDescriptor.h"
#include "host/VST3/VST3Technology.h"
#include "host/src/VST3/src/IndexWalk.h"
#include "host/src/VST3/src/PluginText.h"
#include "host/src/VST3/src/SpeakerArrangements.h"
#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3FilterID.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <utility>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::kResultOk;
using Steinberg::Vst::BusDirection;
using Steinberg::Vst::BusInfo;
using Steinberg::Vst::kAudio;
using Steinberg::Vst::kEvent;
using Steinberg::Vst::kInput;
using Steinberg::Vst::kOutput;
using Steinberg::Vst::SpeakerArrangement;

namespace
{

constexpr int32 kMaxEvents = 2048;

struct SubCategory
{
    std::string_view mText;
    AudioFilterCategory mCategory;
};

// The first that is found anywhere in the sub-categories decides.
constexpr std::array<SubCategory, 17> kSubCategories = {{
    {"Fx|Analyzer", kCategoryVST3Analyzer},
    {"Fx|Delay", kCategoryVST3Delay},
    {"Fx|Reverb", kCategoryVST3Reverb},
    {"Fx|Dynamics", kCategoryVST3Dynamics},
    {"Fx|Mastering", kCategoryVST3Mastering},
    {"Fx|Restoration", kCategoryVST3Restoration},
    {"Fx|Generator", kCategoryVST3Generator},
    {"Fx|Spatial", kCategoryVST3Spatial},
    {"Fx|Distortion", kCategoryVST3Distortion},
    {"Fx|EQ", kCategoryVST3EQ},
    {"Fx|Filter", kCategoryVST3Filter},
    {"Fx|Modulation", kCategoryVST3Modulation},
    {"Fx|Pitch Shift", kCategoryVST3PitchShift},
    {"Fx|Surround", kCategoryVST3Surround},
    {"Fx|Tools", kCategoryVST3Tools},
    {"Fx", kCategoryEffect},
    {"Instrument", kCategoryVST3Instrument},
}};

AudioFilterCategory FindCategory(const std::string& subCategories)
{
    const auto* found =
        std::find_if(kSubCategories.begin(), kSubCategories.end(),
                     [&](const SubCategory& entry) { return subCategories.find(entry.mText) != std::string::npos; });
    return found == kSubCategories.end() ? kCategoryNone : found->mCategory;
}

// Appends at most one bus: none for an arrangement without channels.
void AddToBusDescriptions(SpeakerArrangement arrangement, int busType, UTF16String name,
                          std::vector<AudioFilterBusDescription>& descriptions)
{
    ChannelLayout layout = LayoutOfArrangement(arrangement);
    if (layout.empty())
        return;
    if (name.empty())
        name = ArrangementName(arrangement);
    if (name.empty())
        name = AudioChannelLayoutDescription(layout);
    const auto type = busType != Steinberg::Vst::kMain ? AudioFilterBusDescription::kBusType_SideChain
                                                       : AudioFilterBusDescription::kBusType_Main;
    descriptions.emplace_back(std::move(name), std::move(layout), type);
}

// A layout without an arrangement drops out, so that later ones move up a bus.
void AudioChannelLayoutsToSpeakerArrangement(const std::vector<ChannelLayout>& layouts,
                                             std::vector<SpeakerArrangement>& arrangements)
{
    std::vector<SpeakerArrangement> result;
    for (const ChannelLayout& layout : layouts)
    {
        if (const SpeakerArrangement arrangement = ArrangementOfLayout(layout))
            result.push_back(arrangement);
    }
    arrangements.swap(result);
}

PluginPtr<VST3EventList> MakeEventList(Steinberg::Vst::IComponent& component, BusDirection direction)
{
    if (component.getBusCount(kEvent, direction) <= 0)
        return {};
    return PluginPtr<VST3EventList>::Adopt(new VST3EventList(kMaxEvents));
}

} // namespace

// The buses and event lists that this makes come into use with the next Resume.
void VST3AudioFilter::BuildIOConfiguration()
{
    ClearBusConfiguration();
    mProcessData.inputEvents = nullptr;
    mProcessData.outputEvents = nullptr;
    mInputEvents.Reset();
    mOutputEvents.Reset();
    if (!mComponent)
        return;
    mInputEvents = MakeEventList(*mComponent, kInput);
    mOutputEvents = MakeEventList(*mComponent, kOutput);
    if (!mInitialized)
        return;
    AddInputBuses(ReadBuses(kInput));
    AddOutputBuses(ReadBuses(kOutput));
    ActivateBuses(kInput, Steinberg::Vst::kMain);
    ActivateBuses(kOutput, Steinberg::Vst::kMain);
}

// A bus without an arrangement is left out, one without a description stays.
std::vector<AudioFilterBusDescription> VST3AudioFilter::ReadBuses(BusDirection direction)
{
    std::vector<AudioFilterBusDescription> buses;
    WalkList([&, count = mComponent->getBusCount(kAudio, direction)] { return count; },
             [&](int index)
             {
                 BusInfo info = {};
                 const bool described = mComponent->getBusInfo(kAudio, direction, index, info) == kResultOk;
                 if (!described)
                     info = {};
                 SpeakerArrangement arrangement = 0;
                 const bool arranged = mProcessor->getBusArrangement(direction, index, arrangement) == kResultOk;
                 if (arranged)
                     AddToBusDescriptions(arrangement, info.busType, UTF16String(BoundedText(info.name)), buses);
                 return described || arranged ? IndexWalk::kFound : IndexWalk::kMissing;
             });
    return buses;
}

void VST3AudioFilter::ActivateBuses(BusDirection direction, Steinberg::Vst::BusType type)
{
    WalkList([&, count = mComponent->getBusCount(kAudio, direction)] { return count; },
             [&](int index)
             {
                 BusInfo info = {};
                 if (mComponent->getBusInfo(kAudio, direction, index, info) != kResultOk)
                     return IndexWalk::kMissing;
                 if (info.busType == type)
                     mComponent->activateBus(kAudio, direction, index, 1);
                 return IndexWalk::kFound;
             });
}

void VST3AudioFilter::RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                             const std::vector<ChannelLayout>& outputs)
{
    if (!mInitialized)
        return;
    std::vector<SpeakerArrangement> inputArrangements;
    std::vector<SpeakerArrangement> outputArrangements;
    AudioChannelLayoutsToSpeakerArrangement(inputs, inputArrangements);
    AudioChannelLayoutsToSpeakerArrangement(outputs, outputArrangements);
    if (inputArrangements.empty() || outputArrangements.empty())
        return;
    const auto result =
        mProcessor->setBusArrangements(inputArrangements.data(), static_cast<int32>(inputArrangements.size()),
                                       outputArrangements.data(), static_cast<int32>(outputArrangements.size()));
    if (result == kResultOk)
        BuildIOConfiguration();
}

// Asks for mono and then for stereo, which stays in force: only a filter that is made for it is to be described.
boost::intrusive_ptr<AudioFilterDescriptor> VST3AudioFilter::CreateFilterDescriptor(const PluginLocator& locator,
                                                                                    bool skipCategory)
{
    if (!mInitialized)
        return nullptr;
    const AudioFilterCategory category = skipCategory ? kCategoryNotQueried : FindCategory(mSubCategories);
    const bool synth = category == kCategoryVST3Instrument;
    boost::intrusive_ptr<AudioFilterDescriptor> descriptor(
        new AudioFilterDescriptor(locator, GetDisplayName(), mVendor, 0, category, EncodeFilterID(mClassID.data()),
                                  GetVST3FactoryGuid(), synth));
    descriptor->SetSupportsMono(IsChannelFormatSupported(zebmediatypes::CreateMonoChannelLayout()));
    descriptor->SetSupportsStereo(IsChannelFormatSupported(zebmediatypes::CreateStereoChannelLayout()));
    return descriptor;
}

} // namespace zebaudiofilterhost::vst3
