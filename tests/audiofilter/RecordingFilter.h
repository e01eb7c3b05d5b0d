// A filter that writes down what reaches it.
#pragma once

#include "audiofilter/AudioFilter.h"

#include <map>
#include <vector>

namespace zebaudiofilterhost::testing
{

/// One call of Process.
struct ProcessCall
{
    std::vector<float*> in;
    std::vector<float*> out;
    float** inArray = nullptr;
    float** outArray = nullptr;
    int frames = 0;
    ChannelFlags inFlags;
};

/// One call of SetParameter.
struct ParameterCall
{
    int index;
    float value;
    bool onMainThread;

    bool operator==(const ParameterCall&) const = default;
};

class RecordingFilter : public AudioFilter
{
public:
    /// With `inputs` and `outputs` mono, stereo or longer layouts of unlabelled channels, one bus each.
    RecordingFilter(const std::vector<int>& inputs, const std::vector<int>& outputs);
    ~RecordingFilter() override;

    void Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags) override;
    int GetInitialDelay() const override { return mLatency; }
    int GetParameterCount() const override { return static_cast<int>(mParameters.size()); }
    void SetParameter(int index, float value) override;
    float GetParameter(int index) const override;
    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs,
                                const std::vector<ChannelLayout>& outputs) override;

    std::vector<ProcessCall> mProcessCalls;
    std::vector<ParameterCall> mParameterCalls;
    ChannelFlags mOutFlagsToReport;
    int mLatency = 0;
    std::vector<float> mParameters;
    bool* mDestroyed = nullptr; ///< Set at destruction, if there
};

boost::intrusive_ptr<RecordingFilter> MakeFilter(const std::vector<int>& inputs, const std::vector<int>& outputs);

/// A bus of so many unlabelled channels.
AudioFilterBusDescription MakeBus(int channels);

/// A map of `slots` slots in which each given slot is connected to the given plug-in channel.
ChannelMap MakeMap(int slots, const std::map<int, int>& slotToPlugChannel);

/// The plug-in channel of each slot, -1 for an empty layout.
std::vector<int> PlugChannels(const ChannelMap& map);

/// Buffers of one block for an application's channel row, with pointers to them.
class Buffers
{
public:
    Buffers(int channels, int frames);

    float** Pointers() { return mPointers.data(); }
    float* Channel(int channel) { return mPointers[static_cast<std::size_t>(channel)]; }
    void Fill(float value);

private:
    std::vector<std::vector<float>> mSamples;
    std::vector<float*> mPointers;
};

} // namespace zebaudiofilterhost::testing
