// A real plug-in on a process thread while other threads work on its filter: nothing on our side of the process path
// may allocate, free, lock or call the system.

#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3PluginModule.h"

#include "foundation/zebcore/StringConversion.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/support/RealtimeGuard.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <thread>

namespace zebaudiofilterhost::vst3
{
namespace
{

constexpr int kBlocks = 100000;
constexpr int kFrames = 16;
constexpr unsigned int kChannels = 6;
constexpr Steinberg::Vst::ParamID kGainParameter = 0;

AudioFilterBusDescription Surround()
{
    return AudioFilterBusDescription::CreateSurround51(u"Main", AudioFilterBusDescription::kBusType_Main);
}

boost::intrusive_ptr<VST3AudioFilter> MakeGain()
{
    const std::string path = zebtest::EffectBundle("ZebGain").string();
    const auto module =
        GetVST3Plugin(zebcore::utility::UTF8to16(UTF8String(path.begin(), path.end()), nullptr, nullptr));
    std::vector<UTF16String> ids;
    if (!module || !module->GetPluginInfo(ids) || ids.empty())
    {
        return nullptr;
    }
    return module->CreateVST3AudioFilter(ids.front());
}

// Answers every question, so that the whole process context is filled.
class Host final : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat& /*format*/, int& /*first*/, int& /*second*/) const override
    {
        return false;
    }
    bool GetTempo(utility::Tempo& tempo) const override
    {
        tempo.mTempo = 120.0;
        tempo.mNumerator = 4;
        tempo.mDenominator = 4;
        return true;
    }
    bool GetTransportState(bool& playing, bool& /*recording*/, bool& /*looping*/) const override
    {
        playing = true;
        return true;
    }
};

class ProcessPath : public ::testing::Test
{
protected:
    void SetUp() override
    {
        InitializeMainThreadID();
        mFilter = MakeGain();
        ASSERT_TRUE(mFilter);
        const ChannelLayout stereo = zebmediatypes::CreateStereoChannelLayout();
        mFilter->RequestIOConfiguration({stereo}, {stereo});
        mFilter->SetAudioFilterHost(&mHost);
        mFilter->SetSampleRate(48000.0F);
        mFilter->SetBlockSize(kFrames);
        mFilter->SetMainTargetBus(Surround());
        mFilter->SetUseChannelMap(true);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Input);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Output);
    }

    void TearDown() override
    {
        if (mFilter)
        {
            // Messages that nobody has taken keep their filter, and a flush takes no more than the ring holds.
            for (int flush = 0; flush < 4096; ++flush)
                mFilter->FlushMessageQueue();
            mFilter->SetAudioFilterHost(nullptr);
        }
    }

    void ProcessBlocks()
    {
        std::array<std::array<float, kFrames>, kChannels> input{};
        std::array<std::array<float, kFrames>, kChannels> output{};
        std::array<float*, kChannels> in{};
        std::array<float*, kChannels> out{};
        for (std::size_t channel = 0; channel < kChannels; ++channel)
        {
            input[channel].fill(0.5F);
            in[channel] = input[channel].data();
            out[channel] = output[channel].data();
        }
        for (int block = 0; block < kBlocks; ++block)
        {
            ChannelFlags silent;
            const realtimeguard::Section section;
            mFilter->ProcessWithMapping(in.data(), out.data(), kFrames, ChannelFlags(), silent);
        }
        mDone = true;
    }

    // What a user interface and the timer do meanwhile on the main thread.
    void WorkOnTheFilter(int round)
    {
        const auto direction = round % 2 == 0 ? AudioFilter::kDirection_Input : AudioFilter::kDirection_Output;
        mFilter->PostSetParameter(0, static_cast<float>(round % 100) / 100.0F);
        mFilter->AssignChannelMapping(direction, round % 2, round % static_cast<int>(kChannels));
        if (round % 64 == 0)
        {
            mFilter->restartComponent(Steinberg::Vst::kParamTitlesChanged);
        }
        mFilter->OnUITimerTick();
    }

    // What a plug-in's own thread does: many writers into the ring that the process thread empties.
    void Edit()
    {
        double value = 0.0;
        while (!mDone.load())
        {
            mFilter->beginEdit(kGainParameter);
            mFilter->performEdit(kGainParameter, value);
            mFilter->endEdit(kGainParameter);
            value = value < 1.0 ? value + 0.001 : 0.0;
        }
    }

    Host mHost;
    boost::intrusive_ptr<VST3AudioFilter> mFilter;
    std::atomic<bool> mDone{false};
};

TEST_F(ProcessPath, NeitherAllocatesNorLocksNorCallsTheSystem)
{
    realtimeguard::AnnounceWhatIsMissing();
    realtimeguard::Reset();
    mFilter->Resume();
    std::thread process([this] { ProcessBlocks(); });
    std::thread editor([this] { Edit(); });
    for (int round = 0; !mDone.load(); ++round)
    {
        WorkOnTheFilter(round);
    }
    process.join();
    editor.join();
    mFilter->Suspend();
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();
}

} // namespace
} // namespace zebaudiofilterhost::vst3
