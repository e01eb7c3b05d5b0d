#include "ControlFilter.h"

#include "audiofilter/AudioFilter.h"
#include "audiofilter/GenericParameterInfo.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterRegistrar.h"

#include <algorithm>
#include <array>
#include <atomic>

namespace soak
{

using namespace zebaudiofilterhost;

namespace
{

constexpr Guid kFactoryGuid(0x7a1d03c5U, 0x42b8, 0x4e6f, 0x9c, 0x11, 0x5e, 0x0d, 0x84, 0xa3, 0x6b, 0xf2);
constexpr int kParameters = 16;
constexpr int kLatency = 64; // frames, so that what passes by goes through the delay line

// Takes what buses it is asked for, and scales them by its first parameter.
class ControlFilter final : public AudioFilter
{
public:
    explicit ControlFilter(const UTF16String& id) : AudioFilter(id, u"Control") { SetBuses({}); }

    void RequestIOConfiguration(const std::vector<ChannelLayout>& inputs, const std::vector<ChannelLayout>&) override
    {
        SetBuses(inputs);
    }

    void Process(float** in, float** out, int frames, ChannelFlags inFlags, ChannelFlags& outFlags) override
    {
        const float gain = GetParameter(0);
        for (int channel = 0; channel < GetNumberOfOutputChannels(); ++channel)
        {
            std::transform(in[channel], in[channel] + frames, out[channel],
                           [gain](float sample) { return sample * gain; });
        }
        outFlags = inFlags;
    }

    int GetInitialDelay() const override { return kLatency; }
    int GetParameterCount() const override { return kParameters; }

    void SetParameter(int index, float value) override
    {
        AudioFilter::SetParameter(index, value);
        if (index >= 0 && index < kParameters)
        {
            mValues[static_cast<std::size_t>(index)].store(value, std::memory_order_relaxed);
        }
    }

    float GetParameter(int index) const override
    {
        return index < 0 || index >= kParameters
                   ? 0.0F
                   : mValues[static_cast<std::size_t>(index)].load(std::memory_order_relaxed);
    }

    boost::intrusive_ptr<AudioFilterParameterInfo> GetParameterInfo(int index) const override
    {
        return new GenericParameterInfo(u"Parameter", u"", AudioFilterParameterInfoUnit(0), index, 0.0F, 1.0F, true,
                                        false, 2, 2);
    }

private:
    void SetBuses(const std::vector<ChannelLayout>& layouts)
    {
        auto bus = AudioFilterBusDescription::CreateStereo(u"Main", AudioFilterBusDescription::kBusType_Main);
        if (!layouts.empty())
        {
            bus.SetLayout(layouts.front());
        }
        ClearBusConfiguration();
        AddInputBus(bus);
        AddOutputBus(bus);
    }

    std::array<std::atomic<float>, kParameters> mValues{};
};

boost::intrusive_ptr<AudioFilterDescriptor> Describe()
{
    return new AudioFilterDescriptor(u"Control", 1, AudioFilterCategory(1), kControlFilterID, kFactoryGuid, false);
}

boost::intrusive_ptr<AudioFilter> Make(const UTF16String& id)
{
    return new ControlFilter(id);
}

} // namespace

void RegisterControlFilter()
{
    const AudioFilterRegistrar registrar(Describe, Make);
}

} // namespace soak
