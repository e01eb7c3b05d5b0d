#pragma once

#include "audiofilter/AudioFilter.h"
#include "host/src/VST/src/AudioMasterHandlerMap.h"
#include "host/src/VST/src/VSTAudioFilterEditor.h"
#include "host/src/VST/src/VSTDispatcherBase.h"
#include "host/src/VST/src/VSTPins.h"
#include "host/src/VST/src/VSTSpeakerArrangement.h"

#include <atomic>
#include <cstdint>
#include <vector>

namespace zebaudiofilterhost::vst
{

/// One opened VST 2 plug-in as a filter, and the host that this plug-in talks to: effects only, in single precision,
/// without events.
///
/// A plug-in calls its host from threads of its own, too, until its effClose returns. So everything that such a call
/// can reach, the base included, outlives effClose, and is atomic or published as a whole.
class VSTAudioFilter : public AudioFilter, public VSTDispatcherBase
{
public:
    /// The plug-in's calls to its host, less the instance.
    using AudioMasterHandler = AudioMasterHandlerMap::Handler;

    /// Opens `effect`, which must not be null and is owned from here on. `path` is the binary's or bundle's;
    /// `useFileTitle` names the filter after it, whatever the plug-in calls itself. [main]
    VSTAudioFilter(const UTF16String& filterID, const UTF16String& path, AEffect* effect, bool openFlag,
                   bool useFileTitle);

    /// Closes the plug-in. The filter must be suspended. [main]
    ~VSTAudioFilter() override;

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
    void GetFactoryDefaultPresets(PresetList& list) const override;
    int GetNumFactoryPresets() const override;
    UTF16String GetFactoryPresetName(int index) const override;
    void SetFactoryPreset(int index) override;
    bool LoadChunkData(const PresetData& preset) override;
    bool SaveChunkData(PresetData& preset) const override;

    int GetInitialDelay() const override;
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override;
    bool CanUseSideChaining() const override;
    bool HasCustomEditor() const override;
    boost::intrusive_ptr<AudioFilterEditor> CreateCustomEditor() override;
    boost::intrusive_ptr<AudioFilterDescriptor> CreateFilterDescriptor(const PluginLocator& locator,
                                                                       bool skipCategory) override;

    /// Whether a stereo plug-in says that it serves one channel as well. [any]
    bool CanMono() const;

    /// The plug-in's one way to its host, with an instance or without. [any]
    static long long StaticAudioMasterCallback(AEffect* effect, std::int32_t opcode, std::int32_t index,
                                               long long value, void* ptr, float opt);

    /// What this instance answers; 0 leaves the answer to the static callback. [any]
    long long AudioMasterCallback(int opcode, int index, long long value, void* ptr, float opt);

    /// Handlers come before the instance's own answers, in the order of their owners' addresses; one that answers 0
    /// passes the call on, an empty one raises boost::bad_function_call at the plug-in's next call. A second one of
    /// the same owner is ignored. A call that is under way on another thread may still be in a removed handler, so
    /// its owner lives as long as the filter. [main]
    void AddAudioMasterHandler(void* owner, const AudioMasterHandler& handler);
    void RemoveAudioMasterHandler(void* owner);

    /// Brings the record of audioMasterGetTime up to the moment. What the plug-in wants of it is not looked at. [any]
    void UpdateTimeInfo(long long wanted);

    /// The member that a shell is about to make, 0 for the shell itself. The entry call that depends on it must
    /// follow before any other plug-in is made. [main]
    static int GetCurrentFilterID();
    static void SetCurrentFilterID(int filterID);

private:
    // Construction and destruction.
    void StartTimeInfo();
    void OpenPlugin(const UTF16String& path, bool useFileTitle);
    void ClosePlugin();
    UTF16String ChooseDisplayName(const UTF16String& path, bool useFileTitle) const;
    void BuildParameterInfos();

    // Buses, while suspended. BuildIOConfiguration makes them of the current arrangements or, failing these, of the
    // plug-in's counts.
    void BuildIOConfiguration();
    void FreeCurrentSpeakerArrangements();

    // To be called behind each change of the buses, and in Resume: pointers for the pins, and what the plug-in may
    // ask about them.
    void PreparePins();

    // The record of audioMasterGetTime, which is filled on whatever thread asks.
    void MarkTransport(bool playing);
    void RewindTimeInfo();
    void UpdateMusicalTime(const IAudioFilterHost& host);

    // The process thread's.
    void ProcessSlice(AEffect& effect, float** in, float** out, int offset, int frames);
    void ClearAccumulated(int offset, int frames);

    void Automate(int index, float value);
    long long PinConnected(int index, long long value) const;
    long long GetTime(long long wanted);

    static AudioMasterHandlerMap& sCallbackMap; // from before effOpen to before effClose of each filter
    static std::atomic<int> sCurrentFilterID;

    std::vector<boost::intrusive_ptr<AudioFilterParameterInfo>> mParameterInfos; // by the plug-in's indices
    // The plug-in keeps a pointer to it. Members are only touched through atomic references: its own threads may ask
    // at the same time, and then get a mixture.
    VstTimeInfo mTimeInfo = {};
    [[maybe_unused]] bool mOpenFlag;
    std::atomic<bool> mTransportChanged = false; // to be told once
    AudioMasterHandlerMap mHandlers;
    std::atomic<long long> mCurrentOffset = 0; // in frames
    bool mMonoThroughStereo = false;           // mono buses over two pins a side
    std::vector<float> mScratchOutput;         // the second output pin of mono through stereo, sized in Resume alone
    SpeakerArrangementPtr mInputArrangement;   // what the plug-in agreed to; null otherwise
    SpeakerArrangementPtr mOutputArrangement;
    int mOutputChannelsToClear = 0;                     // set by BuildIOConfiguration
    boost::intrusive_ptr<VSTAudioFilterEditor> mEditor; // made at the first wish
    VSTPins mPins;
    std::atomic<float> mTimeSampleRate = 0.0F; // hertz; the base's is no other thread's to read
    std::atomic<int> mFirstInputBusChannels = 0;
    std::atomic<int> mFirstOutputBusChannels = 0;
};

} // namespace zebaudiofilterhost::vst
