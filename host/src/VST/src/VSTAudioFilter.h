#pragma once

#include "audiofilter/AudioFilter.h"
#include "host/src/VST/src/VSTDispatcherBase.h"

#include <boost/function.hpp>

#include <atomic>
#include <map>
#include <vector>

namespace zebaudiofilterhost::vst
{

class VSTAudioFilterEditor;

/// One opened VST 2 plug-in as a filter, and the host that this plug-in talks to: effects only, in single precision,
/// without events.
class VSTAudioFilter : public AudioFilter, public VSTDispatcherBase
{
public:
    /// The plug-in's calls to its host, less the instance.
    using AudioMasterHandler =
        boost::function<long long(int opcode, int index, long long value, void* ptr, float opt)>;

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
    /// passes the call on. A second one of the same owner is ignored. [main]
    void AddAudioMasterHandler(void* owner, const AudioMasterHandler& handler);
    void RemoveAudioMasterHandler(void* owner);

    /// The member that a shell is about to make, 0 for the shell itself. The entry call that depends on it must
    /// follow before any other plug-in is made. [main]
    static int GetCurrentFilterID();
    static void SetCurrentFilterID(int filterID);
};

} // namespace zebaudiofilterhost::vst
