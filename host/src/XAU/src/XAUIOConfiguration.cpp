// The unit's buses, and what it is asked for.

#include "foundation/zebcore/Trace.h"
#include "host/src/XAU/src/CFOwner.h"
#include "host/src/XAU/src/CallGuarded.h"
#include "host/src/XAU/src/XAUAudioFilter.h"
#include "host/src/XAU/src/XAUChannelCounts.h"
#include "host/src/XAU/src/XAUChannelLayouts.h"

#include <algorithm>
#include <cstring>
#include <limits>

namespace zebaudiofilterhost::xau
{

namespace
{

// More than these are a lie of the unit's.
constexpr UInt32 kMaxElements = 256;
constexpr UInt32 kMaxChannels = 4096;
constexpr UInt32 kMaxChannelInfos = 4096;
constexpr UInt32 kMaxLayoutSize = 1U << 20;

// What is read has so many bytes of room at least: there are units that announce nothing, and then write.
constexpr std::size_t kMinRoom = 4096;

constexpr std::size_t kLayoutHeader = offsetof(AudioChannelLayout, mChannelDescriptions);

AudioStreamBasicDescription MakeFormat(float sampleRate, UInt32 channels)
{
    AudioStreamBasicDescription format = {};
    format.mSampleRate = static_cast<Float64>(sampleRate);
    format.mFormatID = kAudioFormatLinearPCM;
    format.mFormatFlags = kAudioFormatFlagIsFloat | kAudioFormatFlagIsPacked | kAudioFormatFlagIsNonInterleaved;
    format.mBytesPerPacket = sizeof(Float32);
    format.mFramesPerPacket = 1;
    format.mBytesPerFrame = sizeof(Float32);
    format.mChannelsPerFrame = channels;
    format.mBitsPerChannel = 8 * sizeof(Float32);
    return format;
}

SInt16 ToChannelCount(std::size_t channels)
{
    constexpr std::size_t kMost = std::numeric_limits<SInt16>::max();
    return static_cast<SInt16>(std::min(channels, kMost));
}

// False if the bytes do not hold as many descriptions as they say, or none.
bool ReadDescriptions(const std::vector<std::byte>& bytes, UInt32 count, ChannelLayout& layout)
{
    if (count == 0 || count > (bytes.size() - kLayoutHeader) / sizeof(::AudioChannelDescription))
        return false;
    for (UInt32 index = 0; index < count; ++index)
    {
        ::AudioChannelDescription description = {};
        std::memcpy(&description, bytes.data() + kLayoutHeader + index * sizeof(description), sizeof(description));
        layout.emplace_back(TranslateLabel(description.mChannelLabel));
    }
    return true;
}

ChannelLayout TranslateKnownTag(UInt32 tag)
{
    ChannelLayout layout = TranslateTag(tag);
    if (layout.empty())
        ZEB_TRACE("XAUAudioFilter", "Unknown channel layout tag: " << tag);
    return layout;
}

} // namespace

UInt32 XAUAudioFilter::GetElementCount(AudioUnitScope scope) const
{
    UInt32 count = 0;
    UInt32 size = sizeof(count);
    const OSStatus result =
        CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_ElementCount, scope, 0, &count, &size);
    DumpResultIfFailed(result, "GetElementCount()");
    return result == noErr ? std::min(count, kMaxElements) : 0;
}

OSStatus XAUAudioFilter::GetStreamFormat(AudioUnitScope scope, AudioUnitElement element,
                                         AudioStreamBasicDescription& format) const
{
    UInt32 size = sizeof(format);
    return CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_StreamFormat, scope, element, &format,
                                             &size);
}

OSStatus XAUAudioFilter::SetStreamFormat(AudioUnitScope scope, AudioUnitElement element,
                                         const AudioStreamBasicDescription& format)
{
    const bool wasInitialized = mAUInitialized;
    UninitializeAU();
    const OSStatus result = CallGuarded<AudioUnitSetProperty>(mInstance, kAudioUnitProperty_StreamFormat, scope,
                                                              element, &format, sizeof(format));
    DumpResultIfFailed(result, "XAUAudioFilter::SetStreamFormat(),  AudioUnitSetProperty() / "
                               "kAudioUnitProperty_StreamFormat");
    if (wasInitialized)
        InitializeAU();
    return result;
}

// False if the unit does not say.
bool XAUAudioFilter::ReadSupportedChannels(std::vector<AUChannelInfo>& supported) const
{
    constexpr AudioUnitPropertyID kProperty = kAudioUnitProperty_SupportedNumChannels;
    UInt32 size = 0;
    if (CallGuarded<AudioUnitGetProperty>(mInstance, kProperty, kAudioUnitScope_Global, 0, nullptr, &size) != noErr)
        return false;
    const std::size_t count = std::min<std::size_t>(size / sizeof(AUChannelInfo), kMaxChannelInfos);
    const auto announced = static_cast<UInt32>(count * sizeof(AUChannelInfo));
    supported.resize(std::max(count, kMinRoom / sizeof(AUChannelInfo)));
    size = announced;
    if (CallGuarded<AudioUnitGetProperty>(mInstance, kProperty, kAudioUnitScope_Global, 0, supported.data(), &size) !=
        noErr)
        return false;
    supported.resize(std::min(size, announced) / sizeof(AUChannelInfo));
    return true;
}

void XAUAudioFilter::RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                            const std::vector<ChannelLayout>& outputs)
{
    if (inputs.size() != 1 || outputs.size() != 1)
        return;
    ChannelCounts counts = {ToChannelCount(inputs.front().size()), ToChannelCount(outputs.front().size())};
    std::vector<AUChannelInfo> supported;
    if (ReadSupportedChannels(supported))
    {
        if (supported.empty())
            return;
        counts = NegotiateChannelCounts(supported, counts);
    }

    const bool wasInitialized = mAUInitialized;
    UninitializeAU();
    if (RequestChannels(kAudioUnitScope_Input, static_cast<UInt32>(counts.mInputs), inputs.front().size()) == noErr)
        RequestChannels(kAudioUnitScope_Output, static_cast<UInt32>(counts.mOutputs), outputs.front().size());
    if (wasInitialized)
        InitializeAU();
    BuildIOConfiguration(); // also after a failure: the buses tell the truth
}

// Of the first bus. The trace names the application's own request.
OSStatus XAUAudioFilter::RequestChannels(AudioUnitScope scope, UInt32 channels, std::size_t requested)
{
    const AudioStreamBasicDescription format = MakeFormat(mSampleRate, channels);
    const OSStatus result = CallGuarded<AudioUnitSetProperty>(mInstance, kAudioUnitProperty_StreamFormat, scope, 0,
                                                              &format, sizeof(format));
    if (result != noErr)
    {
        const bool isInput = scope == kAudioUnitScope_Input;
        ZEB_TRACE("XAUAudioFilter", "XAUAudioFilter::RequestIOConfiguration(),  AudioUnitSetProperty() / "
                                    "kAudioUnitProperty_StreamFormat / "
                                        << (isInput ? "kAudioUnitScope_Input" : "kAudioUnitScope_Output")
                                        << ", channels: " << requested << " failed with code " << result);
    }
    return result;
}

// Offsets of a rebuild are deliberately put behind the old ones: the callback goes on using those of the first build,
// which units with several inputs were tried with.
void XAUAudioFilter::BuildIOConfiguration()
{
    ClearBusConfiguration();
    mOutputBuffers.reset(); // Resume makes those that fit the new buses
    mInputPointers.clear();
    unsigned long offset = 0;
    const UInt32 inputCount = GetElementCount(kAudioUnitScope_Input);
    for (AudioUnitElement element = 0; element < inputCount; ++element)
    {
        ChannelLayout layout;
        if (!GetAudioChannelLayout(kAudioUnitScope_Input, element, layout))
            continue;
        UTF16String name = ReadElementName(element);
        if (name.empty())
            name = element == 0 ? u"Input" : u"Aux";
        mBusOffsets.push_back(offset);
        offset += layout.size();
        AddInputBus(AudioFilterBusDescription(name, layout, AudioFilterBusDescription::kBusType_Main));
    }
    const UInt32 outputCount = GetElementCount(kAudioUnitScope_Output);
    for (AudioUnitElement element = 0; element < outputCount; ++element)
    {
        ChannelLayout layout;
        if (GetAudioChannelLayout(kAudioUnitScope_Output, element, layout))
            AddOutputBus(AudioFilterBusDescription(u"Output", layout, AudioFilterBusDescription::kBusType_Main));
    }
    mInputChannels = static_cast<unsigned long>(GetNumberOfInputChannels());
    mOutputChannels = static_cast<unsigned long>(GetNumberOfOutputChannels());
}

UTF16String XAUAudioFilter::ReadElementName(AudioUnitElement element) const
{
    CFStringRef name = nullptr;
    UInt32 size = sizeof(CFTypeRef);
    const OSStatus result = CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_ElementName,
                                                              kAudioUnitScope_Input, element, &name, &size);
    if (result != noErr || !name)
        return {};
    const CFOwner owner(name);
    return MACtoZEB(name);
}

bool XAUAudioFilter::GetAudioChannelLayout(AudioUnitScope scope, AudioUnitElement element,
                                           ChannelLayout& layout) const
{
    ChannelLayout found;
    const bool isKnown = ReadChannelLayout(scope, element, found) || ReadFormatLayout(scope, element, found);
    layout = found;
    return isKnown;
}

// False, with an empty layout, where the stream format has to tell.
bool XAUAudioFilter::ReadChannelLayout(AudioUnitScope scope, AudioUnitElement element, ChannelLayout& layout) const
{
    constexpr AudioUnitPropertyID kProperty = kAudioUnitProperty_AudioChannelLayout;
    UInt32 size = 0;
    Boolean isWritable = 0;
    if (CallGuarded<AudioUnitGetPropertyInfo>(mInstance, kProperty, scope, element, &size, &isWritable) != noErr)
    {
        ZEB_TRACE("XAUAudioFilter", "kAudioUnitProperty_AudioChannelLayout unsupported");
        return false;
    }
    std::vector<std::byte> bytes(std::max<std::size_t>(std::min(size, kMaxLayoutSize), kMinRoom));
    size = std::min(size, kMaxLayoutSize);
    if (CallGuarded<AudioUnitGetProperty>(mInstance, kProperty, scope, element, bytes.data(), &size) != noErr ||
        size < kLayoutHeader)
        return false;
    bytes.resize(std::min<std::size_t>(size, bytes.size()));

    ::AudioChannelLayout header = {};
    std::memcpy(&header, bytes.data(), kLayoutHeader);
    switch (header.mChannelLayoutTag)
    {
    case kAudioChannelLayoutTag_UseChannelDescriptions:
        return ReadDescriptions(bytes, header.mNumberChannelDescriptions, layout);
    case kAudioChannelLayoutTag_UseChannelBitmap:
        layout = TranslateBitmap(header.mChannelBitmap);
        return true; // also without a channel
    default:
        layout = TranslateKnownTag(header.mChannelLayoutTag);
        return !layout.empty();
    }
}

// Two channels are left and right, any other number has no roles.
bool XAUAudioFilter::ReadFormatLayout(AudioUnitScope scope, AudioUnitElement element, ChannelLayout& layout) const
{
    AudioStreamBasicDescription format = {};
    const OSStatus result = GetStreamFormat(scope, element, format);
    DumpResultIfFailed(result, "XAUAudioFilter::GetAudioChannelLayout(),  GetStreamFormat()");
    if (result != noErr)
        return false;
    const UInt32 channels = std::min(format.mChannelsPerFrame, kMaxChannels);
    layout = channels == 2 ? zebmediatypes::CreateStereoChannelLayout() : ChannelLayout(channels);
    return !layout.empty();
}

// Without a side chain only the first input is fed, and the others are disconnected.
void XAUAudioFilter::UpdateRenderCallbacks()
{
    const bool hasSideChain = GetSideChainTargetBusChannelCount() != 0;
    const UInt32 count = GetElementCount(kAudioUnitScope_Input);
    for (AudioUnitElement element = 0; element < count; ++element)
    {
        AURenderCallbackStruct callback = {};
        if (element == 0 || hasSideChain)
            callback = {StaticRenderCallback, this};
        DumpResultIfFailed(CallGuarded<AudioUnitSetProperty>(mInstance, kAudioUnitProperty_SetRenderCallback,
                                                             kAudioUnitScope_Input, element, &callback,
                                                             sizeof(callback)),
                           "kAudioUnitProperty_SetRenderCallback");
    }
}

} // namespace zebaudiofilterhost::xau
