#pragma once

#include <AudioToolbox/AudioToolbox.h>

#include <array>
#include <atomic>
#include <map>
#include <memory>
#include <vector>

namespace zebunits
{

struct ParameterDescription
{
    AudioUnitParameterID id;
    const char* name;
    AudioUnitParameterUnit unit;
    Float32 minimum;
    Float32 maximum;
    Float32 defaultValue;
};

struct FactoryPreset
{
    const char* name;
    std::map<AudioUnitParameterID, Float32> values;
};

/// What a unit is made of, said once by its constructor.
struct UnitDescription
{
    AudioComponentDescription component;
    UInt32 version = 0x00010000;
    std::vector<ParameterDescription> parameters = {};
    std::vector<FactoryPreset> presets = {};
    std::vector<AUChannelInfo> channels = {{-1, -1}};
    std::vector<const char*> inputs = {"Main"}; // names of the inputs; none for a generator
};

/// A unit that works on 32-bit floats, one buffer a channel: formats, parameters, presets and class info are done
/// here, and a unit adds its sound. One output.
class Unit
{
public:
    explicit Unit(UnitDescription description);
    virtual ~Unit();
    Unit(const Unit&) = delete;
    Unit& operator=(const Unit&) = delete;

    // The functions behind the selectors.
    virtual OSStatus Initialize();
    virtual OSStatus Uninitialize();
    virtual OSStatus GetPropertyInfo(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                                     UInt32& size, Boolean& isWritable);
    /// `data` has room for the size that GetPropertyInfo told.
    virtual OSStatus GetProperty(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                                 void* data);
    virtual OSStatus SetProperty(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                                 const void* data, UInt32 size);
    virtual OSStatus GetParameter(AudioUnitParameterID id, AudioUnitScope scope, Float32& value);
    virtual OSStatus SetParameter(AudioUnitParameterID id, AudioUnitScope scope, Float32 value);
    virtual OSStatus Reset();
    virtual OSStatus Render(AudioUnitRenderActionFlags& flags, const AudioTimeStamp& time, UInt32 bus, UInt32 frames,
                            AudioBufferList& data);

protected:
    using Channels = std::vector<float*>;

    /// The unit's sound. `inputs` has the channels of each input; a disconnected one is silent.
    virtual void Process(const std::vector<Channels>& inputs, const Channels& outputs, UInt32 frames) = 0;
    /// Seconds.
    virtual Float64 GetLatency() const { return 0.0; }
    /// More of what class info holds: entries for `SaveState` to add, and for `LoadState` to read.
    virtual void SaveState(CFMutableDictionaryRef state) const;
    virtual void LoadState(CFDictionaryRef state);

    Float32 GetValue(AudioUnitParameterID id) const { return mValues.at(id).load(std::memory_order_relaxed); }
    Float64 GetSampleRate() const { return mOutputFormat.mSampleRate; }
    UInt32 GetOutputChannels() const { return mOutputFormat.mChannelsPerFrame; }
    UInt32 GetMaxFrames() const { return mMaxFrames; }

private:
    const ParameterDescription* FindParameter(AudioUnitParameterID id) const;
    AudioStreamBasicDescription* FindFormat(AudioUnitScope scope, AudioUnitElement element);
    UInt32 GetPropertySize(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element);
    void FillParameterInfo(const ParameterDescription& parameter, AudioUnitParameterInfo& info) const;
    CFArrayRef CopyPresets() const;
    CFPropertyListRef CopyClassInfo() const;
    OSStatus SetClassInfo(CFPropertyListRef list);
    OSStatus SetPreset(const AUPreset& preset);
    OSStatus SetFormat(AudioStreamBasicDescription& format, const AudioStreamBasicDescription& wanted) const;
    bool AllowsChannels() const;
    void PullInput(std::size_t input, const AudioTimeStamp& time, UInt32 frames);

    UnitDescription mDescription;
    std::map<AudioUnitParameterID, std::atomic<Float32>> mValues; // a view and the host's thread of sound share them
    std::vector<AUPreset> mPresets;                               // with their names
    std::vector<AudioStreamBasicDescription> mInputFormats;
    AudioStreamBasicDescription mOutputFormat;
    std::vector<AURenderCallbackStruct> mCallbacks; // of each input
    HostCallbackInfo mHost = {};
    UInt32 mMaxFrames = 1156; // what units assume until they are told
    bool mIsInitialized = false;

    // Of a render, sized by Initialize.
    std::vector<std::vector<std::vector<float>>> mInputBuffers;
    std::vector<std::vector<float>> mOutputBuffers;
    std::vector<Channels> mInputs;
    Channels mOutputs;
    std::vector<std::vector<std::byte>> mInputLists; // AudioBufferList of each input
};

/// The instance that a factory function gives, which owns the unit. Null for null.
AudioComponentPlugInInterface* MakeInterface(std::unique_ptr<Unit> unit);

} // namespace zebunits
