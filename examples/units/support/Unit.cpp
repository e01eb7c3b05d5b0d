#include "Unit.h"

#include <algorithm>
#include <cstring>
#include <string>
#include <utility>

namespace zebunits
{

namespace
{

constexpr Float64 kFirstSampleRate = 44100.0;

AudioStreamBasicDescription MakeStereo()
{
    AudioStreamBasicDescription format = {};
    format.mSampleRate = kFirstSampleRate;
    format.mFormatID = kAudioFormatLinearPCM;
    format.mFormatFlags = kAudioFormatFlagIsFloat | kAudioFormatFlagIsPacked | kAudioFormatFlagIsNonInterleaved;
    format.mBytesPerPacket = sizeof(Float32);
    format.mFramesPerPacket = 1;
    format.mBytesPerFrame = sizeof(Float32);
    format.mChannelsPerFrame = 2;
    format.mBitsPerChannel = 8 * sizeof(Float32);
    return format;
}

template <typename T>
void Put(void* data, const T& value)
{
    std::memcpy(data, &value, sizeof(T)); // NOLINT(bugprone-sizeof-expression): of a reference, itself
}

// False for another size than the property's.
template <typename T>
bool Take(const void* data, UInt32 size, T& value)
{
    if (!data || size != sizeof(value))
        return false;
    std::memcpy(&value, data, sizeof(value));
    return true;
}

bool Fits(SInt16 member, UInt32 channels)
{
    if (member >= 0)
        return channels == static_cast<UInt32>(member);
    return member == -1 || channels <= static_cast<UInt32>(-member);
}

bool Allows(const AUChannelInfo& pair, UInt32 inputs, UInt32 outputs)
{
    if (pair.inChannels == -1 && pair.outChannels == -2)
        return true; // in this order: any number on each side
    const bool mustBeEqual = pair.inChannels == -1 && pair.outChannels == -1;
    return Fits(pair.inChannels, inputs) && Fits(pair.outChannels, outputs) && (!mustBeEqual || inputs == outputs);
}

void SetNumber(CFMutableDictionaryRef dictionary, CFStringRef key, CFNumberType type, const void* value)
{
    CFNumberRef number = CFNumberCreate(nullptr, type, value);
    CFDictionarySetValue(dictionary, key, number);
    CFRelease(number);
}

} // namespace

Unit::Unit(UnitDescription description)
    : mDescription(std::move(description))
    , mInputFormats(mDescription.inputs.size(), MakeStereo())
    , mOutputFormat(MakeStereo())
    , mCallbacks(mDescription.inputs.size())
{
    for (const ParameterDescription& parameter : mDescription.parameters)
        mValues.try_emplace(parameter.id, parameter.defaultValue);
    for (const FactoryPreset& preset : mDescription.presets)
        mPresets.push_back({static_cast<SInt32>(mPresets.size()),
                            CFStringCreateWithCString(nullptr, preset.name, kCFStringEncodingUTF8)});
}

Unit::~Unit()
{
    for (const AUPreset& preset : mPresets)
        CFRelease(preset.presetName);
}

OSStatus Unit::Initialize()
{
    if (!AllowsChannels())
        return kAudioUnitErr_FormatNotSupported;
    mInputBuffers.clear();
    mInputs.clear();
    mInputLists.clear();
    for (const AudioStreamBasicDescription& format : mInputFormats)
    {
        const std::size_t channels = format.mChannelsPerFrame;
        mInputBuffers.emplace_back(channels, std::vector<float>(mMaxFrames));
        mInputs.emplace_back(channels);
        mInputLists.emplace_back(sizeof(AudioBufferList) + channels * sizeof(AudioBuffer));
    }
    mOutputBuffers.assign(mOutputFormat.mChannelsPerFrame, std::vector<float>(mMaxFrames));
    mOutputs.resize(mOutputFormat.mChannelsPerFrame);
    mIsInitialized = true;
    return noErr;
}

OSStatus Unit::Uninitialize()
{
    mIsInitialized = false;
    return noErr;
}

bool Unit::AllowsChannels() const
{
    const UInt32 inputs = mInputFormats.empty() ? 0 : mInputFormats.front().mChannelsPerFrame;
    const UInt32 outputs = mOutputFormat.mChannelsPerFrame;
    return std::any_of(mDescription.channels.begin(), mDescription.channels.end(),
                       [&](const AUChannelInfo& pair) { return Allows(pair, inputs, outputs); });
}

const ParameterDescription* Unit::FindParameter(AudioUnitParameterID id) const
{
    const auto found = std::find_if(mDescription.parameters.begin(), mDescription.parameters.end(),
                                    [id](const ParameterDescription& parameter) { return parameter.id == id; });
    return found == mDescription.parameters.end() ? nullptr : &*found;
}

AudioStreamBasicDescription* Unit::FindFormat(AudioUnitScope scope, AudioUnitElement element)
{
    if (scope == kAudioUnitScope_Input && element < mInputFormats.size())
        return &mInputFormats[element];
    return scope == kAudioUnitScope_Output && element == 0 ? &mOutputFormat : nullptr;
}

// 0 for a property that the unit does not have there.
UInt32 Unit::GetPropertySize(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element)
{
    const bool isGlobal = scope == kAudioUnitScope_Global;
    switch (property)
    {
    case kAudioUnitProperty_ClassInfo:
        return isGlobal ? sizeof(CFPropertyListRef) : 0;
    case kAudioUnitProperty_ParameterList:
        return isGlobal ? static_cast<UInt32>(mDescription.parameters.size() * sizeof(AudioUnitParameterID)) : 0;
    case kAudioUnitProperty_ParameterInfo:
        return isGlobal && FindParameter(element) ? sizeof(AudioUnitParameterInfo) : 0;
    case kAudioUnitProperty_StreamFormat:
        return FindFormat(scope, element) ? sizeof(AudioStreamBasicDescription) : 0;
    case kAudioUnitProperty_ElementCount:
        return sizeof(UInt32);
    case kAudioUnitProperty_Latency:
        return isGlobal ? sizeof(Float64) : 0;
    case kAudioUnitProperty_SupportedNumChannels:
        return isGlobal ? static_cast<UInt32>(mDescription.channels.size() * sizeof(AUChannelInfo)) : 0;
    case kAudioUnitProperty_MaximumFramesPerSlice:
        return isGlobal ? sizeof(UInt32) : 0;
    case kAudioUnitProperty_FactoryPresets:
        return isGlobal && !mPresets.empty() ? sizeof(CFArrayRef) : 0;
    case kAudioUnitProperty_ElementName:
        return scope == kAudioUnitScope_Input && element < mDescription.inputs.size() ? sizeof(CFStringRef) : 0;
    default:
        return 0;
    }
}

OSStatus Unit::GetPropertyInfo(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                               UInt32& size, Boolean& isWritable)
{
    size = GetPropertySize(property, scope, element);
    const bool isOneToSet = property == kAudioUnitProperty_ClassInfo || property == kAudioUnitProperty_StreamFormat ||
                            property == kAudioUnitProperty_MaximumFramesPerSlice;
    isWritable = isOneToSet ? 1 : 0;
    const bool mayBeEmpty = property == kAudioUnitProperty_ParameterList && scope == kAudioUnitScope_Global;
    return size > 0 || mayBeEmpty ? noErr : kAudioUnitErr_InvalidProperty;
}

OSStatus Unit::GetProperty(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element, void* data)
{
    switch (property)
    {
    case kAudioUnitProperty_ClassInfo:
        Put(data, CopyClassInfo()); // the caller's, by this interface's custom
        return noErr;
    case kAudioUnitProperty_ParameterList:
        for (std::size_t index = 0; index < mDescription.parameters.size(); ++index)
            Put(static_cast<AudioUnitParameterID*>(data) + index, mDescription.parameters[index].id);
        return noErr;
    case kAudioUnitProperty_ParameterInfo:
        FillParameterInfo(*FindParameter(element), *static_cast<AudioUnitParameterInfo*>(data));
        return noErr;
    case kAudioUnitProperty_StreamFormat:
        Put(data, *FindFormat(scope, element));
        return noErr;
    case kAudioUnitProperty_ElementCount:
        Put(data, scope == kAudioUnitScope_Input ? static_cast<UInt32>(mInputFormats.size()) : UInt32{1});
        return noErr;
    case kAudioUnitProperty_Latency:
        Put(data, GetLatency());
        return noErr;
    case kAudioUnitProperty_SupportedNumChannels:
        std::copy(mDescription.channels.begin(), mDescription.channels.end(), static_cast<AUChannelInfo*>(data));
        return noErr;
    case kAudioUnitProperty_MaximumFramesPerSlice:
        Put(data, mMaxFrames);
        return noErr;
    case kAudioUnitProperty_FactoryPresets:
        Put(data, CopyPresets());
        return noErr;
    case kAudioUnitProperty_ElementName:
        Put(data, CFStringCreateWithCString(nullptr, mDescription.inputs[element], kCFStringEncodingUTF8));
        return noErr;
    default:
        return kAudioUnitErr_InvalidProperty;
    }
}

void Unit::FillParameterInfo(const ParameterDescription& parameter, AudioUnitParameterInfo& info) const
{
    info = {};
    std::strncpy(info.name, parameter.name, sizeof(info.name) - 1);
    info.cfNameString = CFStringCreateWithCString(nullptr, parameter.name, kCFStringEncodingUTF8);
    info.unit = parameter.unit;
    info.minValue = parameter.minimum;
    info.maxValue = parameter.maximum;
    info.defaultValue = parameter.defaultValue;
    info.flags = kAudioUnitParameterFlag_IsReadable | kAudioUnitParameterFlag_IsWritable |
                 kAudioUnitParameterFlag_HasCFNameString | kAudioUnitParameterFlag_CFNameRelease;
}

OSStatus Unit::SetFormat(AudioStreamBasicDescription& format, const AudioStreamBasicDescription& wanted) const
{
    if (mIsInitialized)
        return kAudioUnitErr_Initialized;
    const AudioStreamBasicDescription stereo = MakeStereo();
    if (wanted.mFormatID != stereo.mFormatID || wanted.mFormatFlags != stereo.mFormatFlags ||
        wanted.mChannelsPerFrame == 0 || wanted.mBitsPerChannel != stereo.mBitsPerChannel)
        return kAudioUnitErr_FormatNotSupported;
    format = wanted;
    return noErr;
}

OSStatus Unit::SetProperty(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                           const void* data, UInt32 size)
{
    AudioStreamBasicDescription format = {};
    CFPropertyListRef list = nullptr;
    AUPreset preset = {};
    const bool isInput = scope == kAudioUnitScope_Input && element < mCallbacks.size();
    switch (property)
    {
    case kAudioUnitProperty_StreamFormat:
        if (AudioStreamBasicDescription* target = FindFormat(scope, element))
            return Take(data, size, format) ? SetFormat(*target, format) : kAudioUnitErr_InvalidPropertyValue;
        return kAudioUnitErr_InvalidElement;
    case kAudioUnitProperty_MaximumFramesPerSlice:
        if (mIsInitialized)
            return kAudioUnitErr_Initialized;
        return Take(data, size, mMaxFrames) ? noErr : kAudioUnitErr_InvalidPropertyValue;
    case kAudioUnitProperty_SetRenderCallback:
        return isInput && Take(data, size, mCallbacks[element]) ? noErr : kAudioUnitErr_InvalidElement;
    case kAudioUnitProperty_HostCallbacks:
        return Take(data, size, mHost) ? noErr : kAudioUnitErr_InvalidPropertyValue;
    case kAudioUnitProperty_ClassInfo:
        return Take(data, size, list) ? SetClassInfo(list) : kAudioUnitErr_InvalidPropertyValue;
    case kAudioUnitProperty_PresentPreset:
        return Take(data, size, preset) ? SetPreset(preset) : kAudioUnitErr_InvalidPropertyValue;
    default:
        return kAudioUnitErr_InvalidProperty;
    }
}

CFArrayRef Unit::CopyPresets() const
{
    CFMutableArrayRef presets = CFArrayCreateMutable(nullptr, 0, nullptr);
    for (const AUPreset& preset : mPresets)
        CFArrayAppendValue(presets, &preset);
    return presets;
}

OSStatus Unit::SetPreset(const AUPreset& preset)
{
    if (preset.presetNumber < 0 || static_cast<std::size_t>(preset.presetNumber) >= mDescription.presets.size())
        return kAudioUnitErr_InvalidPropertyValue;
    for (const auto& [id, value] : mDescription.presets[static_cast<std::size_t>(preset.presetNumber)].values)
        mValues.at(id) = value;
    return noErr;
}

// "parameters" holds each value under its ID in decimal.
CFPropertyListRef Unit::CopyClassInfo() const
{
    CFMutableDictionaryRef info =
        CFDictionaryCreateMutable(nullptr, 0, &kCFTypeDictionaryKeyCallBacks, &kCFTypeDictionaryValueCallBacks);
    const AudioComponentDescription& component = mDescription.component;
    SetNumber(info, CFSTR(kAUPresetTypeKey), kCFNumberSInt32Type, &component.componentType);
    SetNumber(info, CFSTR(kAUPresetSubtypeKey), kCFNumberSInt32Type, &component.componentSubType);
    SetNumber(info, CFSTR(kAUPresetManufacturerKey), kCFNumberSInt32Type, &component.componentManufacturer);
    SetNumber(info, CFSTR(kAUPresetVersionKey), kCFNumberSInt32Type, &mDescription.version);
    CFDictionarySetValue(info, CFSTR(kAUPresetNameKey), CFSTR("Untitled"));
    for (const auto& [id, value] : mValues)
    {
        CFStringRef key = CFStringCreateWithCString(nullptr, std::to_string(id).c_str(), kCFStringEncodingASCII);
        const auto wide = static_cast<Float64>(value.load());
        SetNumber(info, key, kCFNumberFloat64Type, &wide);
        CFRelease(key);
    }
    SaveState(info);
    return info;
}

OSStatus Unit::SetClassInfo(CFPropertyListRef list)
{
    if (!list || CFGetTypeID(list) != CFDictionaryGetTypeID())
        return kAudioUnitErr_InvalidPropertyValue;
    const auto* info = static_cast<CFDictionaryRef>(list);
    for (auto& [id, value] : mValues)
    {
        CFStringRef key = CFStringCreateWithCString(nullptr, std::to_string(id).c_str(), kCFStringEncodingASCII);
        const void* number = CFDictionaryGetValue(info, key);
        CFRelease(key);
        if (!number || CFGetTypeID(number) != CFNumberGetTypeID())
            continue;
        Float32 saved = 0.0F;
        CFNumberGetValue(static_cast<CFNumberRef>(number), kCFNumberFloat32Type, &saved);
        value = saved;
    }
    LoadState(info);
    return noErr;
}

void Unit::SaveState(CFMutableDictionaryRef /*state*/) const
{
}

void Unit::LoadState(CFDictionaryRef /*state*/)
{
}

OSStatus Unit::GetParameter(AudioUnitParameterID id, AudioUnitScope scope, Float32& value)
{
    const auto found = mValues.find(id);
    if (scope != kAudioUnitScope_Global || found == mValues.end())
        return kAudioUnitErr_InvalidParameter;
    value = found->second;
    return noErr;
}

OSStatus Unit::SetParameter(AudioUnitParameterID id, AudioUnitScope scope, Float32 value)
{
    const ParameterDescription* parameter = FindParameter(id);
    if (scope != kAudioUnitScope_Global || !parameter)
        return kAudioUnitErr_InvalidParameter;
    mValues.at(id) = std::clamp(value, parameter->minimum, parameter->maximum);
    return noErr;
}

OSStatus Unit::Reset()
{
    return noErr;
}

void Unit::PullInput(std::size_t input, const AudioTimeStamp& time, UInt32 frames)
{
    auto& buffers = mInputBuffers[input];
    auto& list = *reinterpret_cast<AudioBufferList*>(mInputLists[input].data());
    list.mNumberBuffers = static_cast<UInt32>(buffers.size());
    for (std::size_t channel = 0; channel < buffers.size(); ++channel)
    {
        std::fill_n(buffers[channel].begin(), frames, 0.0F);
        list.mBuffers[channel] = {1, frames * static_cast<UInt32>(sizeof(float)), buffers[channel].data()};
    }
    AudioUnitRenderActionFlags flags = 0;
    const AURenderCallbackStruct& callback = mCallbacks[input];
    if (callback.inputProc)
        callback.inputProc(callback.inputProcRefCon, &flags, &time, static_cast<UInt32>(input), frames, &list);
    for (std::size_t channel = 0; channel < buffers.size(); ++channel)
        mInputs[input][channel] = static_cast<float*>(list.mBuffers[channel].mData);
}

OSStatus Unit::Render(AudioUnitRenderActionFlags& /*flags*/, const AudioTimeStamp& time, UInt32 bus, UInt32 frames,
                      AudioBufferList& data)
{
    if (!mIsInitialized)
        return kAudioUnitErr_Uninitialized;
    if (bus != 0)
        return kAudioUnitErr_InvalidElement;
    if (frames > mMaxFrames)
        return kAudioUnitErr_TooManyFramesToProcess;
    if (data.mNumberBuffers != mOutputs.size())
        return kAudio_ParamError;
    for (std::size_t input = 0; input < mInputs.size(); ++input)
        PullInput(input, time, frames);
    for (std::size_t channel = 0; channel < mOutputs.size(); ++channel)
    {
        AudioBuffer& buffer = data.mBuffers[channel];
        if (!buffer.mData)
            buffer.mData = mOutputBuffers[channel].data();
        buffer.mDataByteSize = frames * static_cast<UInt32>(sizeof(float));
        mOutputs[channel] = static_cast<float*>(buffer.mData);
    }
    Process(mInputs, mOutputs, frames);
    return noErr;
}

} // namespace zebunits
