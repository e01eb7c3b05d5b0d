// One effect, whatever the technology of its plug-in.
#pragma once

#include "audiofilter/AudioFilterBusDescription.h"
#include "audiofilter/AudioFilterEditor.h"
#include "audiofilter/AudioFilterParameterInfo.h"
#include "audiofilter/AudioFilterPresets.h"
#include "audiofilter/IAudioFilterHost.h"
#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/Rect.h"
#include "foundation/zebcore/RefCountedObject.h"
#include "utility/CommonTypes.h"
#include "utility/DelayLine.h"
#include "utility/ProcessMessageHandler.h"

#include <boost/core/noncopyable.hpp>
#include <boost/signals2/connection.hpp>
#include <boost/signals2/signal.hpp>
#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <boost/thread/recursive_mutex.hpp>

#include <atomic>
#include <list>
#include <utility>
#include <vector>

namespace zebaudiofilterhost
{

class AudioFilterDescriptor;
class PluginLocator;

ZEB_EXPORT void intrusive_ptr_add_ref(AudioFilterDescriptor* descriptor);
ZEB_EXPORT void intrusive_ptr_release(AudioFilterDescriptor* descriptor);

enum RenderingContext
{
    kRenderingContext_Offline = 0,
    kRenderingContext_Realtime = 1
};

/// One instance of an effect: parameters, presets, buses, channel maps, a process call and an editor.
///
/// Made on the heap and held by boost::intrusive_ptr; a new filter is suspended. Configure it while it is suspended,
/// call Resume, then ProcessWithMapping for each block from one process thread, and Suspend after the last block:
/// nothing here refuses a block at the wrong time. Every virtual has a working default, so the base class is a filter
/// without parameters and buses that reports silence. A filter with a posted parameter change outlives the
/// application's last pointer until the change has run, so suspend it before letting go, and flush it if it gets no
/// ticks: else it stays for ever. It dies on the main thread.
///
/// What a plug-in throws in Process goes no further. Out of its other calls it may pass through, such as
/// SetParameter, and ProcessWithMapping and ticks, which run posted changes: an application that catches it drops the
/// filter.
class ZEB_EXPORT AudioFilter : public virtual zebcore::utility::RefCountedObject,
                               public ProcessMessageHandler,
                               private boost::noncopyable
{
public:
    enum Direction
    {
        kDirection_Input = 0,
        kDirection_Output = 1
    };

    using PresetChangedSignal = boost::signals2::signal<void()>;
    using AutomatedParameterChangeSignal = boost::signals2::signal<void(int, float)>;
    using ParameterPropertiesChangedSignal = boost::signals2::signal<void()>;
    using EditingStateSignal = boost::signals2::signal<void(int, bool)>;
    using ChannelMapChangedSignal = boost::signals2::signal<void(Direction, ChannelMap, ChannelMap)>;
    using TargetFormatChangedSignal = boost::signals2::signal<void()>;
    using SuspendedStateChangedSignal = boost::signals2::signal<void(bool)>;

    /// id: text from which utility::CreateAudioFilter makes the same filter again. A filter that is made on another
    /// thread than the main one gets no timer ticks, so its posted changes wait for Resume, a block or a flush.
    /// [main]
    AudioFilter(const UTF16String& id, const UTF16String& displayName);

    ~AudioFilter() override;

    // Technologies override what follows; the order is that of the virtual table.

    /// Sets the answer to questions of musical time; not owned, may be null. Must outlive the filter, even if another
    /// takes its place: a plug-in's own thread may still be asking it. [main]
    virtual void SetAudioFilterHost(IAudioFilterHost* host);

    /// Hertz. [main, suspended]
    virtual void SetSampleRate(float sampleRate);

    /// Largest number of frames of one block. Takes effect at the next Resume. [main, suspended]
    virtual void SetBlockSize(int frames);

    /// Largest number of frames that the plug-in takes at once; the filter slices larger blocks. [any]
    virtual int GetMaxProcessingBlockSize() const;

    /// Position of the next block in the project, in frames. [process]
    virtual void SetCurrentOffset(long long frames);

    /// One block in the plug-in's own channels; a set bit says that the channel is silent, outFlags start clear. The
    /// application calls ProcessWithMapping instead. The arrays `in` and `out` may be the application's own, so the
    /// pointers in them must not be changed. Here: all of outFlags is set and no buffer is touched. [process]
    virtual void Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags);

    /// One block in the application's channels: routes them through the channel maps if they are in use, runs queued
    /// parameter changes, processes, and delays what passes by the plug-in by its latency. Without output buses, what
    /// passes by is left alone.
    ///
    /// With mapping, `in` and `out` hold a pointer for each main target channel, and for each further application
    /// channel that a map names; without, one for each channel of the plug-in. `frames` must not exceed the block
    /// size. A set bit of inFlags says that the input holds silence: its buffer is not given to the plug-in, but with
    /// mapping it must still be there and be zero, since what passes by is read. A set bit of outFlags says that
    /// the output may be taken as silent without reading it; the plug-in's own bits come in its channel order.
    ///
    /// The input and the output of a channel may be one buffer as long as the maps lead the plug-in's input and
    /// output of one number to the same channel, and channels that pass by may exchange theirs; no others may
    /// overlap. In place, what has gone through the plug-in is what the delay keeps of a channel: when an edit sends
    /// it past the plug-in, the last frames come twice. [process]
    virtual void ProcessWithMapping(float** in, float** out, int frames, ChannelFlags inFlags,
                                    ChannelFlags& outFlags);

    /// Sizes the render arrays, the scratch buffers and the delay line. Resume calls it. [main, suspended]
    void BuildChannelMaps();

    /// Rewrites the render arrays in place, so that running audio follows the maps; arrays whose size has changed
    /// wait for Resume. Whatever edits a map calls it. [main]
    void UpdateChannelMapArraysForRendering();

    /// Whether the filter works on a whole selection at once; false here. [main]
    virtual bool IsOfflineProcess() const;

    /// Whether the result may be longer or shorter than the source; false here. [main]
    virtual bool CanChangeDuration() const;

    /// Whether the filter makes sound without input; false here. [main]
    virtual bool IsGenerator() const;

    /// Start of the selection and length of the source, in seconds, kept for filters that ask. [main]
    virtual void SetSelectionLeft(double position);
    virtual double GetSelectionLeft() const;
    virtual void SetCurrentDuration(double duration);
    virtual double GetCurrentDuration() const;

    /// Length of the result; here that of the source. [main]
    virtual double GetProcessedDuration() const;

    /// Where a position of the source lands in the result, and the way back; here the same. [main]
    virtual double GetProcessedPosition(double position) const;
    virtual double GetOriginalPosition(double position) const;

    /// Length of the result over that of the source; 1.0 here. [main]
    virtual double GetProcessedScale() const;

    /// Frames that OfflineProcess can give for so many frames of input; 0 here. [main]
    virtual int GetMaxOutputBlockSize(int inputFrames) const;

    /// Frames that sound after the input has ended; 4294967295 is an endless tail. 0 here. [main]
    virtual unsigned int GetTail() const;

    /// One block of an offline process: input, output, input frames, room for output frames, channels; the number of
    /// frames given. 0 here. [main]
    virtual int OfflineProcess(float** in, float** out, int inputFrames, int maxOutputFrames, int channels);

    /// Whether the offline process has given all; true here. [main]
    virtual bool OfflineProcessFinished();

    /// Stops processing. Call it after the last block. Fires the suspended-state signal. [main]
    virtual void Suspend();

    /// Runs waiting parameter changes, as many as one flush takes, sizes everything for the block size, buses and
    /// maps of now and for the latency known so far, and starts processing. Fires the suspended-state signal. If
    /// GetInitialDelay differs afterwards, Suspend and Resume once more: what passes by the plug-in is then aligned.
    /// [main, suspended]
    virtual void Resume();

    /// Real time at first. [main, suspended]
    virtual void SetRenderingContext(RenderingContext context);

    /// Both are ignored here. [main]
    virtual void SetDoSpectral(bool spectral);
    virtual void SetPreviewMode(bool preview);

    /// [any]
    virtual int GetParameterCount() const;

    /// Sets a parameter as SetParameter does and fires the automated-parameter signal on this thread. [any]
    virtual void SetParameterAutomated(int index, float value);

    /// Sets a parameter, normalised, without a signal. Indices out of range are ignored. Technologies call this base
    /// operation too: it counts the change. Applications use PostSetParameter while audio runs. [process, or main
    /// while suspended]
    virtual void SetParameter(int index, float value);

    /// The normalised value; 0 out of range. [any]
    virtual float GetParameter(int index) const;

    /// Description of a parameter; null out of range, and here. [main]
    virtual boost::intrusive_ptr<AudioFilterParameterInfo> GetParameterInfo(int index) const;

    /// Text of the parameter's value; here the plain number. [main]
    virtual UTF16String GetParameterString(int index) const;

    /// Data that a filter of the application's own offers, such as a response curve: kind, number of points wanted,
    /// target; the number of points given. 0 here. [main]
    virtual int GetCustomData(int kind, unsigned long count, std::vector<float>& data);
    virtual int GetCustomData(int kind, unsigned long count, std::vector<double>& data);

    /// Format of the filter's presets; a preset of any other version is refused. 1.0 here. [main]
    virtual float GetCurrentPresetVersion() const;

    /// Whether presets hold the plug-in's own bytes instead of parameter values; false here. [main]
    virtual bool DoPresetsUseChunkData() const;

    /// Replaces the list's content by references to the presets that are built into the plug-in. [main]
    virtual void GetFactoryDefaultPresets(PresetList& list) const;

    /// Presets that are built into the plug-in; none here. Indices out of range give an empty name, and are ignored
    /// by SetFactoryPreset. [main]
    virtual int GetNumFactoryPresets() const;
    virtual UTF16String GetFactoryPresetName(int index) const;
    virtual void SetFactoryPreset(int index);

    /// Takes over a preset. False if it does not fit this filter; settings that were read before the failure stay. A
    /// preset with a chunk fits a filter that uses chunks, whatever the plug-in makes of it. Fires the preset-changed
    /// signal in any case. [main]
    virtual bool LoadSettings(const PresetData& preset);

    /// Replaces the content of the preset by the settings of this filter. Changes that the plug-in has not got yet
    /// may be missing: FlushMessageQueue ahead of it, or a tick, hands them over. [main]
    virtual void SaveSettings(PresetData& preset) const;

    /// Takes over a preset's chunk; false on failure, and here. [main]
    virtual bool LoadChunkData(const PresetData& preset);

    /// Writes version and type and is true; technologies add the chunk, and are false without a plug-in. [main]
    virtual bool SaveChunkData(PresetData& preset) const;

    /// Takes over a preset's custom section; false on failure, and here. [main]
    virtual bool LoadCustomData(const PresetData& preset);

    /// Whether a preset may be loaded while audio runs; true here. [main]
    virtual bool ArePresetsSafeForPlayback() const;

    /// Latency in frames; 0 here. Resume asks for it to delay what passes by the plug-in. [main]
    virtual int GetInitialDelay() const;

    /// Asks the plug-in for buses of these layouts; what it granted stands in the bus lists afterwards. An Audio Unit
    /// has none ahead of its first request, and takes one layout for each side, whatever its number of buses. Nothing
    /// here. [main, suspended]
    virtual void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                        const std::vector<ChannelLayout>& outputs);

    /// Whether there are at least two input buses. [main]
    virtual bool CanUseSideChaining() const;

    /// Whether CreateCustomEditor gives an editor; false here. [main]
    virtual bool HasCustomEditor() const;

    /// The plug-in's editor, for most technologies the same one at each call: open it in one place at a time. It must
    /// not outlive the filter. Null if there is none. [main]
    virtual boost::intrusive_ptr<AudioFilterEditor> CreateCustomEditor();

    /// Whether this stands in for a filter whose plug-in is missing; false here. [any]
    virtual bool IsProxy() const;

    /// Mark a gesture of the user on a parameter; fire the editing-state signal on this thread. [any]
    virtual void BeginEditing(int index);
    virtual void EndEditing(int index);

    /// Enclose every load of settings; the second fires the preset-changed signal. [main]
    virtual void StartLoadingSettings();
    virtual void FinishLoadingSettings(bool changed);

    /// Describes this filter for the catalogue; with `skipCategory` the plug-in is not asked for its category. Null
    /// here. [main, suspended]
    virtual boost::intrusive_ptr<AudioFilterDescriptor> CreateFilterDescriptor(const PluginLocator& locator,
                                                                               bool skipCategory);

    /// A new suspended filter with the same sample rate, settings, maps, preset name and, as far as the plug-in
    /// grants them anew, buses; null if it can't be made. Block size, host, display name, flags and editor state stay
    /// behind. [main]
    virtual boost::intrusive_ptr<AudioFilter> Clone() const;

    /// Sets all parameters from a preset's values, each as automated; false, and nothing set, if the count does not
    /// fit. [main]
    virtual bool LoadParams(const PresetData& preset);

    /// Replaces the list's content by all parameter values. [main]
    virtual void SaveParams(std::list<float>& params) const;

    /// Whether presets of this version can be loaded; here only the current version. [main]
    virtual bool ValidatePresetVersion(float version) const;

    /// Whether a preset with so many values can be loaded; here only one with all of them. [main]
    virtual bool ValidateParamCount(int count) const;

    /// Runs at every tick of the library's timer; here it flushes the message queue. [main]
    virtual void OnUITimerTick();

    // Identity

    /// [main]
    UTF16String GetID() const;
    UTF16String GetDisplayName() const;
    void SetDisplayName(const UTF16String& displayName);

    /// What SetAudioFilterHost was given; may be null. [any]
    IAudioFilterHost* GetAudioFilterHost() const;

    // Notes that the application leaves on the filter; the library does not act on them.

    /// [main]
    bool GetHasHighLatency() const;
    void SetHasHighLatency(bool highLatency);
    bool GetHasHighCPU() const;
    void SetHasHighCPU(bool highCPU);
    void SetEditorVisible(bool visible);
    bool GetEditorVisible() const;
    void SetEditorRect(const zebcore::geom::RectT<int>& rect);
    zebcore::geom::RectT<int> GetEditorRect() const;
    const std::pair<UTF16String, bool>& GetPresetNameAndDirtyState() const;
    void SetPresetNameAndDirtyState(const std::pair<UTF16String, bool>& state);

    // Parameters

    /// Sets a parameter ahead of the next block or, while suspended, at the next timer tick. Never waits. The process
    /// thread is handed 32 changes at a time, in the order of posting; what does not fit follows at the next post,
    /// tick or FlushMessageQueue. Without ticks, flush every 32 changes. [main]
    void PostSetParameter(int index, float value);

    /// Grows with every SetParameter, LoadSettings and BumpParameterDirtyCount; for pollers. [any]
    unsigned int GetParameterDirtyCount() const;
    void BumpParameterDirtyCount();

    /// Whether a load of settings is under way. [any]
    bool IsLoadingSettings() const;

    // Buses of the plug-in. Changing them changes nothing else; sizes follow at the next Resume.

    /// [main, suspended]
    void ClearInputBusConfiguration();
    void ClearOutputBusConfiguration();
    void ClearBusConfiguration();
    void AddInputBus(const AudioFilterBusDescription& bus);
    void AddOutputBus(const AudioFilterBusDescription& bus);
    void AddInputBuses(const std::vector<AudioFilterBusDescription>& buses);
    void AddOutputBuses(const std::vector<AudioFilterBusDescription>& buses);

    /// Valid until the buses change. [main]
    const std::vector<AudioFilterBusDescription>& GetInputBuses() const;
    const std::vector<AudioFilterBusDescription>& GetOutputBuses() const;

    /// Replaces both arguments by copies of the lists. [main]
    void GetBusConfiguration(std::vector<AudioFilterBusDescription>& inputs,
                             std::vector<AudioFilterBusDescription>& outputs) const;

    /// Sums over all buses. [main]
    int GetNumberOfInputChannels() const;
    int GetNumberOfOutputChannels() const;

    // Routing. The application's channels are those of the main target bus and, behind them, those of the side-chain
    // target bus. In a channel map a slot is an application channel; its layout holds the number of the plug-in
    // channel that it is connected to, as a label; its source channel is its own index while it is in use.

    /// Replaces a map, which reaches running audio without a pause, and fires the channel-map signal. [main]
    void SetChannelMap(const ChannelMap& map, Direction direction);
    ChannelMap GetChannelMap(Direction direction) const;

    /// Connects a plug-in channel to an application channel, freeing both ends; a negative plug-in channel empties
    /// the slot. A negative slot, and one that a negative plug-in channel does not find, is ignored. Fires the
    /// channel-map signal. [main]
    void AssignChannelMapping(Direction direction, int plugChannel, int slot);

    /// Disconnects a plug-in channel. Fires the channel-map signal even if it was not connected. [main]
    void RemoveChannelMapping(Direction direction, int plugChannel);

    /// Selects routing through the maps. Call Resume before the next block, which sizes what routing needs. Off at
    /// first. [main, suspended]
    void SetUseChannelMap(bool use);
    bool GetUseChannelMap() const;

    /// Whether the map is the identity over all channels of the plug-in. The target buses play no part. [main]
    bool IsChannelMapDefault(Direction direction) const;

    /// Makes the map the identity, as far as both the plug-in and the target buses reach. No signal. [main,
    /// suspended]
    void SetDefaultChannelMap(Direction direction);

    /// Connects each side-chain channel, as far as there are any, to the first plug-in input whose number no slot has
    /// as its source. With `clearFirst`, plug-in inputs that bear the numbers of the side-chain channels are
    /// disconnected first. Fires the channel-map signal. [main]
    void AutoConnectSideChainChannels(bool clearFirst);

    /// A map from the first of the buses to the channels of the target with the same labels or, if no label agrees,
    /// by position. [any]
    static ChannelMap BuildBestFitChannelMap(const std::vector<AudioFilterBusDescription>& buses,
                                             const ChannelLayout& target);

    /// The layouts that the application offers. Setters fire the target-format signal; a change of the channel count
    /// takes effect at the next Resume. [main]
    void SetChannelMapTargetChannelLayout(const ChannelLayout& layout);
    ChannelLayout GetChannelMapTargetChannelLayout() const;
    void SetMainTargetBus(const AudioFilterBusDescription& bus);
    void SetSideChainTargetBus(const AudioFilterBusDescription& bus);
    AudioFilterBusDescription GetMainTargetBus() const;
    AudioFilterBusDescription GetSideChainTargetBus() const;
    int GetSideChainTargetBusChannelCount() const;

    /// Configures the plug-in with this layout for input and output, and tells whether it took it. The plug-in stays
    /// so configured. [main, suspended]
    bool IsChannelFormatSupported(const ChannelLayout& layout);

    /// Read and write both maps. False if routing through the maps is off, or a section or record is missing; an
    /// input map that could be read stays. Running audio does not follow before the map is set again.
    ///
    /// Written is what connects the main target bus with a bus of the plug-in. Connections of other application
    /// channels, of a side chain for instance, and of channels of the plug-in beyond its widest bus are not:
    /// AutoConnectSideChainChannels brings those back, or a map that the application keeps itself (GetChannelMap). A
    /// connection that the filter has no channel for is read as none, so a filter without buses, such as a proxy that
    /// was just made, gets them first. [main]
    bool LoadChannelMapSettings(const PropList* settings);
    bool SaveChannelMapSettings(PropList* settings) const;

    // Cloning

    /// Runs the filter's queued parameter changes, as many as one flush takes, and clones it; `filter` must not be
    /// null. [main]
    static boost::intrusive_ptr<AudioFilter> Clone(boost::intrusive_ptr<AudioFilter> filter);

    // Signals. Slots run on the thread that fires, and must not drop the last pointer to the filter.

    /// [any]
    AutomatedParameterChangeSignal& GetAutomatedParameterChangeSignal();
    ParameterPropertiesChangedSignal& GetParameterPropertiesChangedSignal();
    SuspendedStateChangedSignal& GetSuspendedStateChangedSignal();

    /// Parameter index, new value; fired on whatever thread the plug-in calls from. Slots must not throw. [any]
    boost::signals2::connection
    ConnectAutomatedParameterChange(const AutomatedParameterChangeSignal::slot_type& slot);

    /// Names or ranges of parameters have changed. [any]
    boost::signals2::connection
    ConnectParameterPropertiesChanged(const ParameterPropertiesChangedSignal::slot_type& slot);

    /// A load of settings has ended. [any]
    boost::signals2::connection ConnectPresetChanged(const PresetChangedSignal::slot_type& slot);

    /// Parameter index, true at the begin and false at the end of a gesture. [any]
    boost::signals2::connection ConnectEditingStateChange(const EditingStateSignal::slot_type& slot);

    /// Direction, old map, new map. [any]
    boost::signals2::connection ConnectChannelMapChanged(const ChannelMapChangedSignal::slot_type& slot);

    /// A target layout or target bus has changed. [any]
    boost::signals2::connection ConnectTargetFormatChanged(const TargetFormatChangedSignal::slot_type& slot);

    /// The new suspended state. [any]
    boost::signals2::connection ConnectSuspendedStateChanged(const SuspendedStateChangedSignal::slot_type& slot);

protected:
    /// False as long as nobody has asked for the automated-parameter signal: then firing it, which locks and counts
    /// even when nobody listens, can be left out. [any]
    bool CanAutomationBeHeard() const { return mAutomationCanBeHeard.load(std::memory_order_relaxed); }

    /// Fires the automated-parameter signal, if it can be heard. To ask for the signal instead would count as asking
    /// to hear it. [any]
    void FireAutomatedParameterChange(int index, float value)
    {
        if (CanAutomationBeHeard())
            mAutomatedParameterChangeSignal(index, value);
    }

private:
    friend class AudioFilterProxy; // Takes over the sample rate and block size of the filter that it stands in for

    struct RenderIndices;

    void TickWhileHeld();

    ChannelMap& MapOf(Direction direction);
    const ChannelMap& MapOf(Direction direction) const;
    void PublishMapChange(Direction direction, const ChannelMap& oldMap);
    int FirstSideChainInput() const;

    bool LoadByType(const PresetData& preset);
    bool LoadFactoryPreset(const PresetData& preset);

    unsigned int LatencyForDelayLine() const;
    void CollectRenderIndices(RenderIndices& indices) const;

    bool IsRoutedStraight(const RenderIndices& indices) const;
    float** RouteInputs(float** in, bool mapped, ChannelFlags& flags);
    float** RouteOutputs(float** out);
    void MarkSilentChannels(ChannelFlags& flags);
    void PassChannels(float** in, float** out, int frames, ChannelFlags& flags);
    void PassAtOnce(float** in, float** out, unsigned int frames, ChannelFlags& flags);
    bool PassesCrossed(float** in, float** out);
    void PassDelayed(float** in, float** out, unsigned int frames, ChannelFlags& flags);

    // The order is that of destruction, backwards: the connection to the tick goes before the signals above it. No
    // tick can come between, since both belong to the main thread.
    PresetChangedSignal mPresetChangedSignal;
    AutomatedParameterChangeSignal mAutomatedParameterChangeSignal;
    ParameterPropertiesChangedSignal mParameterPropertiesChangedSignal;
    EditingStateSignal mEditingStateSignal;
    std::atomic<bool> mAutomationCanBeHeard{false}; // Once set, stays; who connects orders nothing else by it

protected:
    RenderingContext mRenderingContext = kRenderingContext_Realtime;

private:
    boost::signals2::scoped_connection mUITimerConnection;
    ChannelMapChangedSignal mChannelMapChangedSignal;
    TargetFormatChangedSignal mTargetFormatChangedSignal;
    SuspendedStateChangedSignal mSuspendedStateChangedSignal;

protected:
    UTF16String mFilterID;
    UTF16String mDisplayName;
    std::atomic<IAudioFilterHost*> mHost{nullptr}; // Not owned; read by the process thread
    float mSampleRate = 0.0F;                      // Hertz
    double mSelectionLeft = 0.0;
    double mCurrentDuration = 0.0;
    int mBlockSize = 0; // Frames
    std::vector<AudioFilterBusDescription> mInputBuses;
    std::vector<AudioFilterBusDescription> mOutputBuses;
    std::atomic<bool> mSuspended{true}; // Read by any thread; orders nothing

private:
    std::pair<UTF16String, bool> mPresetNameAndDirtyState;
    std::atomic<unsigned int> mParameterDirtyCount{0}; // Counted by any thread; orders nothing
    std::atomic<bool> mHasHighLatency{false};
    std::atomic<bool> mHasHighCPU{false};
    std::atomic<bool> mEditorVisible{false};
    zebcore::geom::RectT<int> mEditorRect{};
    std::atomic<bool> mLoadingSettings{false};
    ChannelMap mInputChannelMap;
    ChannelMap mOutputChannelMap;
    AudioFilterBusDescription mMainTargetBus;
    AudioFilterBusDescription mSideChainTargetBus;
    mutable boost::recursive_mutex mChannelMapMutex; // Guards the two maps; never taken by the process thread
    boost::intrusive_ptr<DelayLine> mDelayLine;

    // Read by the process thread while the main thread stores elements: always through atomic references. Sizes
    // change in BuildChannelMaps only. An element of -1 says that nothing is connected, or that the list ends here.
    std::vector<int> mInputChannelIndices;  // Application channel of each plug-in input
    std::vector<int> mOutputChannelIndices; // Application channel of each plug-in output
    std::vector<int> mDelayedChannels;      // Application channels that pass by the plug-in
    std::vector<int> mSilentChannels;       // Application channels that only feed the plug-in

    // Each plug-in channel is the application's of the same number, and none feeds it alone or passes by: a block may
    // pass the application's own pointers. Says nothing while maps are not in use. As good as the elements above.
    std::atomic<bool> mRoutedStraight{false};
    bool mDelaying = false;                  // There is a latency, so the delay line takes in every block
    unsigned long long mPluginInputBits = 0; // The bits of mInputPointers

    std::vector<float*> mInputPointers;
    std::vector<float*> mOutputPointers;
    std::vector<float> mSilenceBuffer;
    std::vector<float> mDiscardBuffer;
    std::atomic<bool> mUseChannelMap{false};
};

} // namespace zebaudiofilterhost
