// Real plug-ins on a process thread while the main thread works on their filters: nothing on our side of the process
// path, the answers to the plug-in's own questions included, may allocate, free, lock or call the system.

#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTPluginModule.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/support/RealtimeGuard.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <thread>

namespace zebaudiofilterhost::vst
{
namespace
{

constexpr int kFrames = 16;
constexpr unsigned int kChannels = 6;

boost::intrusive_ptr<VSTAudioFilter> MakeFixture(std::string_view name)
{
    const auto module = GetVSTPlugin(zebcore::utility::UTF16FromNarrow(zebtest::VST2Fixture(name).string()));
    std::vector<UTF16String> ids;
    if (!module || !module->GetPluginInfo(ids) || ids.empty())
        return nullptr;
    return boost::dynamic_pointer_cast<VSTAudioFilter>(module->CreateAudioFilter(ids.front()));
}

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
        mAsked = mAsked + 1;
        return true;
    }
    bool GetTransportState(bool& /*playing*/, bool& /*recording*/, bool& /*looping*/) const override { return false; }

    mutable std::atomic<int> mAsked = 0;
};

struct Path
{
    const char* fixture;
    std::size_t channels;
    int blocks;
    int ticksOfTime; // how often the plug-in asks in a block
};

void PrintTo(const Path& path, std::ostream* out)
{
    *out << path.fixture;
}

class VST2ProcessPath : public testing::TestWithParam<Path>
{
protected:
    void SetUp() override
    {
        InitializeMainThreadID();
        const zebtest::FixtureRecorder recorder(zebtest::VST2Fixture(GetParam().fixture));
        recorder.SetRecording(false); // which allocates
        mFilter = MakeFixture(GetParam().fixture);
        ASSERT_TRUE(mFilter);
        const ChannelLayout layout(GetParam().channels);
        mFilter->RequestIOConfiguration({layout}, {layout});
        mFilter->SetAudioFilterHost(&mHost);
        mFilter->SetSampleRate(48000.0F);
        mFilter->SetBlockSize(kFrames);
        mFilter->SetMainTargetBus(
            AudioFilterBusDescription::CreateSurround51(u"Main", AudioFilterBusDescription::kBusType_Main));
        mFilter->SetUseChannelMap(true);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Input);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Output);
    }

    void TearDown() override
    {
        if (!mFilter)
            return;
        mFilter->FlushMessageQueue();
        mFilter->SetAudioFilterHost(nullptr);
    }

    void ProcessBlocks()
    {
        std::array<std::array<float, kFrames>, kChannels> input{};
        std::array<std::array<float, kFrames>, kChannels> output{};
        std::array<float*, kChannels> in{};
        std::array<float*, kChannels> out{};
        for (std::size_t channel = 0; channel < kChannels; ++channel)
        {
            in[channel] = input[channel].data();
            out[channel] = output[channel].data();
        }
        for (int block = 0; block < GetParam().blocks; ++block)
        {
            for (auto& channel : output)
                channel.fill(0.0F); // for the plug-in that adds
            ChannelFlags silent;
            const realtimeguard::Section section;
            mFilter->SetCurrentOffset(static_cast<long long>(block) * kFrames);
            mFilter->ProcessWithMapping(in.data(), out.data(), kFrames, ChannelFlags(), silent);
        }
        mDone = true;
    }

    // What a user interface, a view and a scan do meanwhile on the main thread.
    void Work(int round)
    {
        const auto direction = round % 2 == 0 ? AudioFilter::kDirection_Input : AudioFilter::kDirection_Output;
        mFilter->PostSetParameter(0, static_cast<float>(round % 100) / 100.0F);
        mFilter->AssignChannelMapping(direction, round % 2, round % static_cast<int>(kChannels));
        mFilter->AddAudioMasterHandler(this, [](int, int, long long, void*, float) { return 0LL; });
        if (round % 64 == 0)
        {
            EXPECT_TRUE(MakeFixture("Normal"));
        }
        mFilter->RemoveAudioMasterHandler(this);
        mFilter->OnUITimerTick();
    }

    Host mHost;
    boost::intrusive_ptr<VSTAudioFilter> mFilter;
    std::atomic<bool> mDone = false;
};

TEST_P(VST2ProcessPath, NeitherAllocatesNorLocksNorCallsTheSystem)
{
    realtimeguard::AnnounceWhatIsMissing();
    realtimeguard::Reset();
    mFilter->Resume();
    std::thread process([this] { ProcessBlocks(); });
    for (int round = 0; !mDone; ++round)
        Work(round);
    process.join();
    mFilter->Suspend();
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();
    EXPECT_EQ(mHost.mAsked, GetParam().blocks * GetParam().ticksOfTime);
    EXPECT_GT(mFilter->GetParameterDirtyCount(), 0U);
}

INSTANTIATE_TEST_SUITE_P(Fixtures, VST2ProcessPath,
                         testing::Values(Path{"AsksForTime", 2, 100000, 1}, Path{"Accumulates", 2, 10000, 0},
                                         Path{"CanMono", 1, 10000, 0}),
                         testing::PrintToStringParamName());

} // namespace
} // namespace zebaudiofilterhost::vst
