#pragma once

#include "audiofilter/AudioFilter.h"
#include "audiofilter/Tempo.h"
#include "host/src/VST3/src/CallGate.h"
#include "host/src/VST3/src/HostRunLoop.h"
#include "host/src/VST3/src/ParameterChangeTransfer.h"
#include "host/src/VST3/src/ParameterChanges.h"
#include "host/src/VST3/src/ParameterTable.h"
#include "host/src/VST3/src/PluginPtr.h"
#include "host/src/VST3/src/VST3AudioFilterEditor.h"
#include "host/src/VST3/src/VST3EventList.h"
#include "host/src/VST3/src/VST3VendorInterfaces.h"
#include "utility/src/Published.h"

#include <pluginterfaces/base/ipluginbase.h>
#include <pluginterfaces/vst/ivstaudioprocessor.h>
#include <pluginterfaces/vst/ivstcomponent.h>
#include <pluginterfaces/vst/ivsteditcontroller.h>
#include <pluginterfaces/vst/ivsthostapplication.h>
#include <pluginterfaces/vst/ivstprocesscontext.h>
#include <pluginterfaces/vst/ivstunits.h>

#include <array>
#include <atomic>
#include <cstdint>
#include <string>
#include <vector>

namespace zebaudiofilterhost::vst3
{

inline constexpr std::uint32_t kNoParameterID = 4294967295U;

/// One class of a VST 3 bundle as a filter, and the host that this plug-in talks to.
///
/// A plug-in that does not come up leaves an object without buses that never processes: IsInitialized tells. What was
/// made of it until then stays, and is still asked for state and parameters. The plug-in's references on the host
/// faces do not count; the filter lives by its own count alone.
class VST3AudioFilter : public AudioFilter,
                        public Steinberg::Vst::IHostApplication,
                        public Steinberg::Vst::IComponentHandler,
                        public Steinberg::Vst::IUnitHandler,
                        public IVST3CorvaneVendorSpecificHost
{
public:
    /// Makes the plug-in and everything of it. `factory` gets a reference and must not be null. What fails throws
    /// nothing; what the plug-in throws passes through, once it is taken down. [main]
    VST3AudioFilter(Steinberg::IPluginFactory* factory, const Steinberg::PClassInfo& classInfo);

    /// Takes the plug-in down in a fixed order. The filter must be suspended. [main]
    ~VST3AudioFilter() override;

    /// Whether the plug-in came up. [any]
    bool IsInitialized() const { return mInitialized; }

    void SetSampleRate(float sampleRate) override;
    void SetBlockSize(int blockSize) override;
    int GetMaxProcessingBlockSize() const override;
    void SetCurrentOffset(long long offset) override;
    void Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags) override;
    unsigned int GetTail() const override;
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
    bool LoadChunkData(const PresetData& presetData) override;
    bool SaveChunkData(PresetData& presetData) const override;

    int GetInitialDelay() const override;
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override;
    bool HasCustomEditor() const override;
    boost::intrusive_ptr<AudioFilterEditor> CreateCustomEditor() override;
    boost::intrusive_ptr<AudioFilterDescriptor> CreateFilterDescriptor(const PluginLocator& locator,
                                                                       bool skipCategory) override;
    using AudioFilter::Clone;
    boost::intrusive_ptr<AudioFilter> Clone() const override;
    void OnUITimerTick() override;
    void FlushMessageQueue() override;

    // FUnknown of all faces: the counts are no counts, each returns 1. [any]
    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** obj) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    // IHostApplication [any]
    Steinberg::tresult PLUGIN_API getName(Steinberg::Vst::String128 name) override;
    Steinberg::tresult PLUGIN_API createInstance(Steinberg::TUID classID, Steinberg::TUID interfaceID,
                                                 void** obj) override;

    // IComponentHandler [any]
    Steinberg::tresult PLUGIN_API beginEdit(Steinberg::Vst::ParamID id) override;
    Steinberg::tresult PLUGIN_API performEdit(Steinberg::Vst::ParamID id, Steinberg::Vst::ParamValue value) override;
    Steinberg::tresult PLUGIN_API endEdit(Steinberg::Vst::ParamID id) override;
    Steinberg::tresult PLUGIN_API restartComponent(Steinberg::int32 flags) override;

    // IUnitHandler [any]
    Steinberg::tresult PLUGIN_API notifyUnitSelection(Steinberg::Vst::UnitID unitID) override;
    Steinberg::tresult PLUGIN_API notifyProgramListChange(Steinberg::Vst::ProgramListID listID,
                                                          Steinberg::int32 programIndex) override;

    // IVST3CorvaneVendorSpecificHost [main]
    Steinberg::int32 PLUGIN_API GetUILanguage() override;
    Steinberg::int32 PLUGIN_API GetThemeXMLLength() override;
    void PLUGIN_API GetThemeXML(unsigned char* buffer) override;
    void PLUGIN_API GainFocus(long direction) override;
    const char* PLUGIN_API GetUILanguageString() override;

private:
    // Queues for the parameters of a rebuild, on their way to whoever processes, and those replaced on the way back.
    struct QueueSet
    {
        ParameterChanges::Queues mInput;
        ParameterChanges::Queues mOutput;
        QueueSet* mNext = nullptr;
    };

    // Construction, in this order.
    void BringUp(const Steinberg::PClassInfo& classInfo);
    UTF16String ReadClassInfo(const Steinberg::PClassInfo& classInfo);
    UTF16String ReadUnicodeClassInfo(Steinberg::IPluginFactory3& factory);
    UTF16String ReadClassInfo2(Steinberg::IPluginFactory2& factory);
    bool CreatePlugin(UTF16String& name);
    bool CreateController();
    void ConnectController();
    void FindFactoryPresets();
    void CreateEditor();

    // Destruction, in this order.
    void TakeDown();
    void ReleaseParameters();
    void DisconnectController();
    void ReleaseController();
    void ReleaseComponent();

    Steinberg::FUnknown* HostContext();

    // Buses, while suspended.
    void BuildIOConfiguration();
    std::vector<AudioFilterBusDescription> ReadBuses(Steinberg::Vst::BusDirection direction);
    void ActivateBuses(Steinberg::Vst::BusDirection direction, Steinberg::Vst::BusType type);
    void SetupProcessing();
    void AllocateBusBuffers();
    void FreeBusBuffers();
    void FillProcessData();
    void FlushParameterChanges();

    // Parameters.
    void BuildParameterInfos();
    void RebuildParameterInfos();
    void OfferQueues(int count);
    void TakeOfferedQueues();
    void FreeSpentQueues();
    void TakeProgramChange(std::uint32_t id, int index);
    void PassOutputToController();
    boost::intrusive_ptr<VST3ParameterInfo> FindParameterInfo(int index) const;
    bool FindParameterID(int index, std::uint32_t& id) const;
    int FindParameterIndex(Steinberg::Vst::ParamID id) const;

    // The process thread's.
    void UpdateProcessContext();
    void UpdateMusicalTime(const utility::Tempo& tempo);
    void PassInputSilence(ChannelFlags inFlags);
    void ProcessSlice(float** in, float** out, int offset, int frames);
    void CallProcess();
    void ClearProcessedInput();
    ChannelFlags CollectOutputSilence() const;

    // Some plug-ins change their buses when they refuse an arrangement, or at any other call, and go by what they
    // have then: so many more channels are there for them to touch.
    static constexpr std::size_t kSpareChannels = 64;

    std::array<char, 16> mClassID = {};
    PluginPtr<Steinberg::Vst::IComponent> mComponent;
    PluginPtr<Steinberg::Vst::IAudioProcessor> mProcessor;
    PluginPtr<Steinberg::Vst::IEditController> mController;
    PluginPtr<IVST3CorvaneVendorSpecificEffect> mVendorEffect;
    PluginPtr<Steinberg::Vst::IUnitInfo> mUnitInfo;
    boost::intrusive_ptr<VST3AudioFilterEditor> mEditor;
    PluginPtr<Steinberg::IPluginFactory> mFactory;
    bool mInitialized = false;          // implies a component and a processor
    bool mConnected = false;            // the two connection points
    bool mControllerIsSeparate = false; // a class of its own, initialised here
    UTF16String mVendor;
    std::string mSubCategories;
    Steinberg::Vst::ProcessData mProcessData; // reused for every call of process
    Steinberg::Vst::ProcessContext mProcessContext = {};
    bool mProcessing = false; // after setProcessing(1)
    int mMaxBlockSize = 1024; // largest numSamples of one call of process
    int mNumPrograms = 0;
    std::atomic<std::uint32_t> mProgramChangeID = kNoParameterID; // published behind the index
    std::atomic<int> mProgramChangeIndex = 0;
    std::atomic<int> mLatency = 0; // frames
    Published<ParameterTable> mParameters;
    std::vector<Steinberg::Vst::AudioBusBuffers> mInputBuffers; // between Resume and Suspend
    std::vector<Steinberg::Vst::AudioBusBuffers> mOutputBuffers;
    std::vector<unsigned long long> mInputBits; // of each input bus, the bits of its channels in the filter's flags
    std::vector<float*> mInputChannels;         // what the bus buffers point into, by channel of the filter
    std::vector<float*> mOutputChannels;
    std::vector<float> mSilence;            // behind those of the inputs
    std::vector<float> mDiscard;            // behind those of the outputs
    PluginPtr<VST3EventList> mInputEvents;  // null without an event bus
    ParameterChanges mInputChanges;         // what process reads
    ParameterChangeTransfer mInputTransfer; // waiting for the processor
    PluginPtr<VST3EventList> mOutputEvents;
    ParameterChanges mOutputChanges;         // what process writes
    ParameterChangeTransfer mOutputTransfer; // waiting for the controller
    bool mProcessErrorReported = false;
    std::atomic<unsigned int> mRebuildsAsked = 0;    // by restartComponent, and not yet answered
    std::atomic<QueueSet*> mOfferedQueues = nullptr; // owned; taken by the next block, flush or Resume
    std::atomic<QueueSet*> mSpentQueues = nullptr;   // owned list; freed on the main thread
    std::atomic<bool> mFlushing = false;
    HostRunLoop mRunLoop;
    CallGate mRestarts; // of restartComponent, which asks controller and processor
};

} // namespace zebaudiofilterhost::vst3
