// What buses a plug-in has: by the speaker arrangements that it agreed to or, without any, by the number of its pins.

#include "foundation/zebcore/Trace.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTSpeakerArrangement.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <map>
#include <string_view>
#include <utility>
#include <vector>

namespace zebaudiofilterhost::vst
{

namespace
{

constexpr const char* kTraceCategory = "VSTAudioFilter::RequestIOConfiguration()";

constexpr auto kMain = AudioFilterBusDescription::kBusType_Main;

// The first answer of effGetVstVersion that takes speaker arrangements.
constexpr int kFirstVersionWithArrangements = 2300;

// Of one side.
struct BusNames
{
    std::u16string_view mMono;
    std::u16string_view mStereo;
    std::u16string_view mSurround51;
    std::u16string_view mMultiMono;
};

constexpr BusNames kInputNames = {u"Mono In", u"Stereo In", u"Surround 5.1 In", u"Multi-Mono In"};
constexpr BusNames kOutputNames = {u"Mono Out", u"Stereo Out", u"Surround 5.1 Out", u"Multi-Mono Out"};

// Deliberate: an output of any other number of pins is named like an input, as long as the plug-in has no
// arrangements.
constexpr BusNames kOutputNamesByCount = {u"Mono Out", u"Stereo Out", u"Surround 5.1 Out", u"Multi-Mono In"};

AudioFilterBusDescription CreateAudioFilterBusDescriptionFromNumChannels(std::u16string_view name, int channelCount)
{
    const auto size = static_cast<std::size_t>(std::clamp(channelCount, 0, VSTPins::kMaxPins));
    return {UTF16String(name), ChannelLayout(size), kMain};
}

AudioFilterBusDescription CreateNamed(int arrangementType, int channelCount, const BusNames& names)
{
    if (arrangementType == kSpeakerArr51)
        return AudioFilterBusDescription::CreateSurround51(UTF16String(names.mSurround51), kMain);
    if (arrangementType == kSpeakerArrStereo)
        return AudioFilterBusDescription::CreateStereo(UTF16String(names.mStereo), kMain);
    if (arrangementType == kSpeakerArrMono && channelCount == 1)
        return AudioFilterBusDescription::CreateMono(UTF16String(names.mMono), kMain);
    return CreateAudioFilterBusDescriptionFromNumChannels(names.mMultiMono, channelCount);
}

AudioFilterBusDescription CreateFromArrangement(const VstSpeakerArrangement& arrangement, const BusNames& names)
{
    return CreateNamed(arrangement.type, arrangement.numChannels, names);
}

int ArrangementTypeOfCount(int channelCount)
{
    switch (channelCount)
    {
    case 1:
        return kSpeakerArrMono;
    case 2:
        return kSpeakerArrStereo;
    case 6:
        return kSpeakerArr51;
    default:
        return kSpeakerArrUserDefined;
    }
}

AudioFilterBusDescription CreateFromCount(int channelCount, const BusNames& names)
{
    return CreateNamed(ArrangementTypeOfCount(channelCount), channelCount, names);
}

enum class Side
{
    Input,
    Output
};

// Plug-ins may keep the addresses of the arrangements that they were asked with, so these stay for good, and stay
// reachable. One for each side and number of channels serves all, since nothing else of a layout counts: a filter
// that is configured again and again leaves no more behind. What a plug-in may have written into it is made good.
VstSpeakerArrangement* LastingArrangement(Side side, const ChannelLayout& layout)
{
    static auto& kept = *new std::map<std::pair<Side, std::size_t>, SpeakerArrangementPtr>();
    SpeakerArrangementPtr fresh = BuildSpeakerArrangement(layout);
    SpeakerArrangementPtr& lasting = kept[{side, layout.size()}];
    if (lasting)
        std::memcpy(lasting.get(), fresh.get(), SpeakerArrangementSize(layout.size()));
    else
        lasting = std::move(fresh);
    return lasting.get();
}

// Pointers travel as numbers.
long long AddressOf(const void* pointer)
{
    return std::bit_cast<long long>(pointer);
}

bool IsBelievable(const VstSpeakerArrangement* arrangement)
{
    return arrangement != nullptr && arrangement->numChannels > 0 && arrangement->numChannels <= kMaxArrangedChannels;
}

// Only a plug-in with so many pins is taken to have kept more than the declared records: some keep these, and the
// number of channels that they were asked for.
int ReadableRecords(int pins)
{
    constexpr int kDeclared = 8;
    return std::max(kDeclared, pins);
}

// Of both sides, or of none.
struct Agreement
{
    SpeakerArrangementPtr mInput;
    SpeakerArrangementPtr mOutput;
};

bool OfferArrangements(const VSTDispatcherBase& plugin, const ChannelLayout& input, const ChannelLayout& output)
{
    const long long inputAddress = AddressOf(LastingArrangement(Side::Input, input));
    VstSpeakerArrangement* const outputArrangement = LastingArrangement(Side::Output, output);
    const bool taken = plugin.Dispatcher(effSetSpeakerArrangement, 0, inputAddress, outputArrangement, 0.0F) != 0;
    ZEB_TRACE(kTraceCategory,
              (taken ? "effSetSpeakerArrangement succeeded, inputs= " : "effSetSpeakerArrangement failed, inputs= ")
                  << input.size() << ", outputs= " << output.size());
    return taken;
}

// Asks with the host's layouts and takes what the plug-in then says, which need not be the same.
Agreement Negotiate(const VSTDispatcherBase& plugin, const AEffect& effect, const ChannelLayout& input,
                    const ChannelLayout& output)
{
    if (!OfferArrangements(plugin, input, output))
        return {};
    const VstSpeakerArrangement* inputAnswer = nullptr;
    const VstSpeakerArrangement* outputAnswer = nullptr;
    if (plugin.Dispatcher(effGetSpeakerArrangement, 0, AddressOf(&inputAnswer), &outputAnswer, 0.0F) == 0)
    {
        ZEB_TRACE(kTraceCategory, "effGetSpeakerArrangement failed");
        return {};
    }
    ZEB_TRACE(kTraceCategory, "effGetSpeakerArrangement succeeded");
    if (!IsBelievable(inputAnswer) || !IsBelievable(outputAnswer))
        return {};
    return {CopySpeakerArrangement(*inputAnswer, ReadableRecords(effect.numInputs)),
            CopySpeakerArrangement(*outputAnswer, ReadableRecords(effect.numOutputs))};
}

} // namespace

void VSTAudioFilter::FreeCurrentSpeakerArrangements()
{
    mInputArrangement.reset();
    mOutputArrangement.reset();
}

void VSTAudioFilter::BuildIOConfiguration()
{
    ClearBusConfiguration();
    if (mInputArrangement && mOutputArrangement)
    {
        AddInputBus(CreateFromArrangement(*mInputArrangement, kInputNames));
        AddOutputBus(CreateFromArrangement(*mOutputArrangement, kOutputNames));
    }
    else
    {
        const int inputs = GetEffect() ? GetEffect()->numInputs : 0;
        const int outputs = GetEffect() ? GetEffect()->numOutputs : 0;
        ZEB_TRACE("VST", "BuildIOConfiguration(), using numInputs/numOutputs, numInputs=" << inputs << ", numOutputs="
                                                                                          << outputs);
        AddInputBus(CreateFromCount(inputs, kInputNames));
        AddOutputBus(CreateFromCount(outputs, kOutputNamesByCount));
    }
    mOutputChannelsToClear = GetNumberOfOutputChannels();
    PreparePins();
}

void VSTAudioFilter::RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                            const std::vector<ChannelLayout>& outputs)
{
    mMonoThroughStereo = false;
    FreeCurrentSpeakerArrangements();
    if (inputs.size() != 1 || outputs.size() != 1)
        return;
    const ChannelLayout& input = inputs.front();
    const ChannelLayout& output = outputs.front();
    if (GetEffect() && Dispatcher(effGetVstVersion, 0, 0, nullptr, 0.0F) >= kFirstVersionWithArrangements)
    {
        Agreement agreement = Negotiate(*this, *GetEffect(), input, output);
        mInputArrangement = std::move(agreement.mInput);
        mOutputArrangement = std::move(agreement.mOutput);
    }
    BuildIOConfiguration();

    const bool stereo = GetNumberOfInputChannels() == 2 && GetNumberOfOutputChannels() == 2;
    if (!stereo || !CanMono() || input.size() != 1 || output.size() != 1)
        return;
    ZEB_TRACE(kTraceCategory, "CanMono");
    mMonoThroughStereo = true;
    ClearBusConfiguration();
    AddInputBus(AudioFilterBusDescription::CreateMono(UTF16String(kInputNames.mMono), kMain));
    AddOutputBus(AudioFilterBusDescription::CreateMono(UTF16String(kOutputNames.mMono), kMain));
    PreparePins();
}

bool VSTAudioFilter::CanUseSideChaining() const
{
    const std::pair channels(GetNumberOfInputChannels(), GetNumberOfOutputChannels());
    return channels == std::pair(4, 2) || channels == std::pair(2, 1) || channels == std::pair(3, 2);
}

} // namespace zebaudiofilterhost::vst
