// A hundred thousand blocks on a process thread while the main thread works on the filter.
#include "tests/audiofilter/RecordingFilter.h"
#include "tests/support/RealtimeGuard.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace zebaudiofilterhost
{
namespace
{

using testing::Buffers;
using testing::MakeBus;
using testing::MakeMap;

constexpr int kBlocks = 100000;
constexpr int kFrames = 16;
constexpr int kChannels = 6;

// A stereo effect with latency that does its work without allocating.
class StereoFilter : public AudioFilter
{
public:
    StereoFilter() : AudioFilter(u"1:stereo", u"Stereo")
    {
        AddInputBus(MakeBus(2));
        AddOutputBus(MakeBus(2));
    }

    int GetInitialDelay() const override { return 37; }

    void SetParameter(int index, float value) override
    {
        mGain = value;
        AudioFilter::SetParameter(index, value);
    }

    void Process(float** in, float** out, int frames, ChannelFlags, ChannelFlags&) override
    {
        for (int channel = 0; channel < 2; ++channel)
        {
            for (int i = 0; i < frames; ++i)
                out[channel][i] = in[channel][i] * mGain;
        }
    }

private:
    float mGain = 1.0F;
};

class RenderingThreads : public ::testing::Test
{
protected:
    RenderingThreads() : mFilter(new StereoFilter)
    {
        InitializeMainThreadID();
        mFilter->SetBlockSize(kFrames);
        mFilter->SetMainTargetBus(MakeBus(kChannels));
        mFilter->SetUseChannelMap(true);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Input);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Output);
    }

    void ProcessBlocks()
    {
        Buffers in(kChannels, kFrames);
        Buffers out(kChannels, kFrames);
        in.Fill(1.0F);
        ChannelFlags flags;
        for (int block = 0; block < kBlocks; ++block)
        {
            const realtimeguard::Section section;
            mFilter->ProcessWithMapping(in.Pointers(), out.Pointers(), kFrames, ChannelFlags(), flags);
        }
        mDone = true;
    }

    // What a user interface does meanwhile.
    void WorkOnTheFilter(int round)
    {
        const auto direction = round % 2 == 0 ? AudioFilter::kDirection_Input : AudioFilter::kDirection_Output;
        mFilter->PostSetParameter(0, static_cast<float>(round % 100) / 100.0F);
        mFilter->AssignChannelMapping(direction, round % 2, round % kChannels);
        if (round % 5 == 0)
            mFilter->RemoveChannelMapping(direction, round % 3);
        if (round % 7 == 0)
            mFilter->SetChannelMap(MakeMap(kChannels, {{round % kChannels, 0}, {(round + 1) % kChannels, 1}}),
                                   direction);
        mFilter->FlushMessageQueue();
        mFilter->SetHasHighCPU(round % 2 == 0);
    }

    // What a third thread may ask.
    void Watch()
    {
        unsigned int last = 0;
        while (!mDone.load())
        {
            const unsigned int count = mFilter->GetParameterDirtyCount();
            EXPECT_GE(count, last);
            last = count;
            mFilter->GetAudioFilterHost();
            mFilter->IsLoadingSettings();
        }
    }

    boost::intrusive_ptr<AudioFilter> mFilter;
    std::atomic<bool> mDone{false};
};

TEST_F(RenderingThreads, TheProcessPathNeitherAllocatesNorLocksNorCallsTheSystem)
{
    realtimeguard::AnnounceWhatIsMissing();
    realtimeguard::Reset();
    mFilter->Resume();
    std::thread process([this] { ProcessBlocks(); });
    std::thread watcher([this] { Watch(); });
    int round = 0;
    while (!mDone.load())
        WorkOnTheFilter(round++);
    process.join();
    watcher.join();
    mFilter->Suspend();
    for (int posted = 0; posted <= round; posted += 32) // What the ring could not take at once
        mFilter->FlushMessageQueue();
    EXPECT_EQ(mFilter->GetParameterDirtyCount(), static_cast<unsigned int>(round));
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();
}

TEST_F(RenderingThreads, TheGuardSeesALockThatAParameterSlotTakesInABlock)
{
    if (!realtimeguard::IsActive())
        GTEST_SKIP() << "the realtime guard sees nothing in this build";
    struct Offender : public StereoFilter
    {
        void SetParameter(int index, float value) override { BeginEditing(static_cast<int>(value) + index); }
    };
    boost::intrusive_ptr<AudioFilter> offender(new Offender);
    offender->Resume();
    offender->PostSetParameter(0, 1.0F);
    realtimeguard::Reset();
    {
        Buffers buffers(2, 1);
        ChannelFlags flags;
        const realtimeguard::Section section;
        offender->ProcessWithMapping(buffers.Pointers(), buffers.Pointers(), 1, ChannelFlags(), flags);
    }
    EXPECT_GT(realtimeguard::Count(realtimeguard::Violation::Lock), 0U);
    realtimeguard::Reset();
}

} // namespace
} // namespace zebaudiofilterhost
