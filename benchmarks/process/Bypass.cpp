#include "benchmarks/process/Bypass.h"

#include "benchmarks/process/BenchBundle.h"

#include <cstring>
#include <stdexcept>

namespace zebaudiofilterhost::benchmarks
{

namespace
{

constexpr std::size_t kBlockBytes = sizeof(float) * kBypassFrames;

class IdleFilter final : public AudioFilter
{
public:
    explicit IdleFilter(int latency) : AudioFilter(u"idle", u"Idle"), mLatency(latency) {}

    int GetInitialDelay() const override { return mLatency; }

private:
    int mLatency;
};

} // namespace

BypassWork::BypassWork(int channels, int latency) : mChannels(channels), mLatency(latency)
{
    mIn.Fill(0);
}

void BypassWork::Verify()
{
    const int blocks = 3 * (mLatency / kBypassFrames + 2); // Round the ring's end, too
    for (int block = 0; block < blocks; ++block)
    {
        const long long firstFrame = static_cast<long long>(block) * kBypassFrames;
        mIn.Fill(firstFrame);
        mOut.Clear();
        Run();
        CheckBlock(firstFrame);
    }
}

void BypassWork::CheckBlock(long long firstFrame)
{
    for (int channel = kTargetChannels - mChannels; channel < kTargetChannels; ++channel)
        for (int frame = 0; frame < kBypassFrames; ++frame)
        {
            const long long source = firstFrame + frame - mLatency;
            const float expected = source < 0 ? 0.0F : Block::GetSample(channel, source);
            if (mOut.GetChannels()[channel][frame] != expected)
                throw std::runtime_error("a channel does not pass by");
        }
}

FilterBypassWork::FilterBypassWork(int channels, int latency)
    : BypassWork(channels, latency), mFilter(new IdleFilter(latency))
{
    const auto type = AudioFilterBusDescription::kBusType_Main;
    const auto stereo = AudioFilterBusDescription::CreateStereo(u"Main", type);
    mFilter->AddInputBus(stereo);
    mFilter->AddOutputBus(stereo);
    mFilter->SetMainTargetBus(AudioFilterBusDescription::CreateSurround71(u"Target", type));
    for (int channel = 0; channel < kTargetChannels - channels; ++channel)
    {
        mFilter->AssignChannelMapping(AudioFilter::kDirection_Input, channel, channel);
        mFilter->AssignChannelMapping(AudioFilter::kDirection_Output, channel, channel);
    }
    mFilter->SetUseChannelMap(true);
    mFilter->SetSampleRate(static_cast<float>(kSampleRate));
    mFilter->SetBlockSize(kBypassFrames);
    mFilter->Resume();
}

FilterBypassWork::~FilterBypassWork()
{
    mFilter->Suspend();
}

void FilterBypassWork::Run()
{
    ChannelFlags silent;
    mFilter->ProcessWithMapping(mIn.GetChannels(), mOut.GetChannels(), kBypassFrames, ChannelFlags(), silent);
}

// The store holds whole blocks, so that no copy is ever split.
CopyBypassWork::CopyBypassWork(int channels, int latency)
    : BypassWork(channels, latency / kBypassFrames * kBypassFrames)
{
    const std::size_t frames = static_cast<std::size_t>(mLatency) + kBypassFrames;
    if (latency > 0)
        mStores.assign(static_cast<std::size_t>(channels), std::vector<float>(frames));
    mRead = kBypassFrames % frames;
}

void CopyBypassWork::Run()
{
    float** const in = mIn.GetChannels() + (kTargetChannels - mChannels);
    float** const out = mOut.GetChannels() + (kTargetChannels - mChannels);
    if (mStores.empty())
    {
        for (int channel = 0; channel < mChannels; ++channel)
            std::memcpy(out[channel], in[channel], kBlockBytes);
        return;
    }
    for (std::size_t channel = 0; channel < mStores.size(); ++channel)
        std::memcpy(mStores[channel].data() + mWrite, in[channel], kBlockBytes);
    for (std::size_t channel = 0; channel < mStores.size(); ++channel)
        std::memcpy(out[channel], mStores[channel].data() + mRead, kBlockBytes);
    mWrite = (mWrite + kBypassFrames) % mStores.front().size();
    mRead = (mRead + kBypassFrames) % mStores.front().size();
}

} // namespace zebaudiofilterhost::benchmarks
