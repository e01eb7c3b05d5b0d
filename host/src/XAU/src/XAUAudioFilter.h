#pragma once

#include "audiofilter/AudioFilter.h"
#include "audiofilter/Tempo.h"
#include "host/src/XAU/src/XAUAudioFilterEditor.h"
#include "host/src/XAU/src/XAUParameterInfo.h"

#include <AudioToolbox/AudioToolbox.h>

#include <atomic>
#include <cstddef>
#include <map>
#include <memory>
#include <vector>

namespace zebaudiofilterhost
{

class PluginModuleInfo;

} // namespace zebaudiofilterhost

namespace zebaudiofilterhost::xau
{

/// Traces a call of the Audio Unit interface that failed; changes nothing. [any but process]
void DumpResultIfFailed(OSStatus code, const char* call);
/// The same. [any]
void DumpRealtimeResultIfFailed(OSStatus code, const char* call);

/// Frames that a unit is asked for at once at most. Longer blocks are cut.
inline constexpr int kMaxChunk = 1024;

/// One instance of an Audio Unit as a filter: pulls sound out of it, feeds its inputs from a callback, tells it the
/// host's time and hears its changes. What the unit fails at is traced and goes no further.
class XAUAudioFilter : public AudioFilter
{
public:
    /// Null if there is no such component, or if it gives no instance. [main]
    static boost::intrusive_ptr<XAUAudioFilter> Create(const UTF16String& filterID);

    /// What a scan records of the unit of a locator: null and no descriptors if it cannot be made. Two arguments are
    /// not used. [main]
    static boost::intrusive_ptr<PluginModuleInfo>
    EnumerateFilters(const PluginLocator& locator, int, int,
                     std::vector<boost::intrusive_ptr<AudioFilterDescriptor>>& descriptors);

    /// Owns `instance`, which must not be null, also if it throws, and initialises it. Makes no buses:
    /// RequestIOConfiguration does. [main]
    XAUAudioFilter(const UTF16String& filterID, AudioComponent component, AudioUnit instance);
    ~XAUAudioFilter() override;

    void SetSampleRate(float sampleRate) override;
    void SetBlockSize(int blockSize) override;
    int GetMaxProcessingBlockSize() const override;
    void SetCurrentOffset(long long offset) override;
    void Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags) override;
    void Suspend() override;
    void Resume() override;

    int GetParameterCount() const override;
    void SetParameter(int index, float value) override;
    float GetParameter(int index) const override;
    boost::intrusive_ptr<AudioFilterParameterInfo> GetParameterInfo(int index) const override;
    UTF16String GetParameterString(int index) const override;

    bool DoPresetsUseChunkData() const override;
    int GetNumFactoryPresets() const override;
    UTF16String GetFactoryPresetName(int index) const override;
    void SetFactoryPreset(int index) override;
    bool LoadChunkData(const PresetData& preset) override;
    bool SaveChunkData(PresetData& preset) const override;

    int GetInitialDelay() const override;
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override;
    bool HasCustomEditor() const override;
    boost::intrusive_ptr<AudioFilterEditor> CreateCustomEditor() override;
    boost::intrusive_ptr<AudioFilterDescriptor> CreateFilterDescriptor(const PluginLocator& locator,
                                                                       bool skipCategory) override;

    /// Each does nothing where it is done already. [main, suspended]
    void InitializeAU();
    void UninitializeAU();
    bool IsAUInitialized() const { return mAUInitialized; }

    /// 0 on failure. [main]
    UInt32 GetElementCount(AudioUnitScope scope) const;
    OSStatus GetStreamFormat(AudioUnitScope scope, AudioUnitElement element,
                             AudioStreamBasicDescription& format) const;
    /// Uninitialises the unit meanwhile. [main, suspended]
    OSStatus SetStreamFormat(AudioUnitScope scope, AudioUnitElement element,
                             const AudioStreamBasicDescription& format);
    OSStatus SetSampleRate(AudioUnitScope scope, AudioUnitElement element, double rate);
    /// Makes the buses anew from what the unit says. [main, suspended]
    void BuildIOConfiguration();
    /// Whether the layout is known; it may be one of no channels. [main]
    bool GetAudioChannelLayout(AudioUnitScope scope, AudioUnitElement element, ChannelLayout& layout) const;

    /// Borrowed. [any]
    AudioUnit GetComponentInstance() const { return mInstance; }

    /// Feeds an input of the unit. Always 0. [process]
    OSStatus RenderCallback(AudioUnitRenderActionFlags* flags, const AudioTimeStamp* timeStamp, UInt32 bus,
                            UInt32 frames, AudioBufferList* ioData);
    static OSStatus StaticRenderCallback(void* refCon, AudioUnitRenderActionFlags* flags,
                                         const AudioTimeStamp* timeStamp, UInt32 bus, UInt32 frames,
                                         AudioBufferList* ioData);

    // The host's time, for the unit; `hostUserData` is the filter. Always 0. [process]
    static OSStatus GetBeatAndTempo(void* hostUserData, Float64* outBeat, Float64* outTempo);
    static OSStatus GetMusicalTimeLocation(void* hostUserData, UInt32* outDelta, Float32* outNumerator,
                                           UInt32* outDenominator, Float64* outDownBeat);
    static OSStatus GetTransportState(void* hostUserData, Boolean* outPlaying, Boolean* outChanged,
                                      Float64* outSample, Boolean* outCycling, Float64* outCycleStart,
                                      Float64* outCycleEnd);

    /// Passes on gestures and changes of the unit's own. A null event is nothing. [main]
    void EventListenerProc(void* object, const AudioUnitEvent* event, UInt64 hostTime, AudioUnitParameterValue value);
    static void StaticEventListenerProc(void* refCon, void* object, const AudioUnitEvent* event, UInt64 hostTime,
                                        AudioUnitParameterValue value);

private:
    // A list of variable length.
    struct BufferList
    {
        explicit BufferList(std::size_t count);
        AudioBufferList& Get() const;
        /// As before each call of AudioUnitRender: the unit brings its own memory.
        void Reset();

        std::size_t mCount;
        std::unique_ptr<std::byte[]> mMemory;
    };

    void BuildParameterInfos();
    std::vector<AudioUnitParameterID> ReadParameterList(AudioUnitScope scope,
                                                        std::vector<AudioUnitParameterID>& room) const;
    void SetHostCallbacks();
    void ListenToUnit();
    void Listen(AudioUnitEventType type, AudioUnitParameterID parameter, const char* call);
    /// Null for an unknown index; lives as long as the filter. [any]
    XAUParameterInfo* FindParameter(int index) const;
    void NotifyListeners(AudioUnitParameterID parameter, AudioUnitScope scope) const;
    const AUPreset* GetFactoryPreset(int index) const;

    bool ReadSupportedChannels(std::vector<AUChannelInfo>& supported) const;
    OSStatus RequestChannels(AudioUnitScope scope, UInt32 channels, std::size_t requested);
    bool ReadChannelLayout(AudioUnitScope scope, AudioUnitElement element, ChannelLayout& layout) const;
    bool ReadFormatLayout(AudioUnitScope scope, AudioUnitElement element, ChannelLayout& layout) const;
    UTF16String ReadElementName(AudioUnitElement element) const;
    void UpdateRenderCallbacks();

    void SetUp();
    void TakeDown() noexcept;
    void RenderChunk(float** in, float** out, int offset, int frames);
    void CopyOutputs(float** out, int offset, int frames);
    void LendInput(std::size_t channel, UInt32 frames, AudioBuffer& buffer);
    bool ReadTempo(utility::Tempo& tempo) const;

    AudioComponent mComponent;
    AudioUnit mInstance;
    CFArrayRef mFactoryPresets = nullptr;
    std::vector<boost::intrusive_ptr<XAUParameterInfo>> mParameterInfos;
    unsigned long mInputChannels = 0;
    unsigned long mOutputChannels = 0;
    std::vector<unsigned long> mBusOffsets; // first channel of each input bus among all input channels
    std::unique_ptr<BufferList> mOutputBuffers;
    float** mCurrentInputs = nullptr; // while the unit renders
    int mCurrentFrames = 0;           // of the chunk that it renders
    AudioTimeStamp mRenderTime = {};
    bool mAUInitialized = false;
    std::vector<float*> mInputPointers;
    std::vector<float> mInputScratch; // a chunk of each input channel
    std::map<int, boost::intrusive_ptr<XAUParameterInfo>> mParameterByIndex;
    std::map<unsigned int, int> mIndexByParameterID;
    AUEventListenerRef mListener = nullptr;
    std::atomic<long long> mCurrentOffset{0}; // samples; read by the unit's threads, orders nothing
    boost::intrusive_ptr<XAUAudioFilterEditor> mEditor;
};

} // namespace zebaudiofilterhost::xau
