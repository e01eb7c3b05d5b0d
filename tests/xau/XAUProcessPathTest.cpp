// Real units on a process thread while the main thread changes their parameters and hears of it: nothing on our side
// of the process path, the component layer and the answers to the units' questions included, may allocate, free, lock
// or call the system.

#include "foundation/zebcore/MainThreadLoop.h"
#include "host/src/XAU/src/XAUAudioFilter.h"
#include "host/src/XAU/src/XAUComponentID.h"
#include "tests/support/RealtimeGuard.h"
#include "tests/support/VariableGuard.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <thread>

namespace zebaudiofilterhost::xau
{
namespace
{

constexpr int kFrames = 16;
constexpr unsigned int kChannels = 4; // of the application: the side chain has the last two
constexpr int kBlocks = 20000;

struct Path
{
    const char* name;
    OSType type;
    OSType subType;
    bool hasSideChain;
};

void PrintTo(const Path& path, std::ostream* out)
{
    *out << path.name;
}

class Host final : public IAudioFilterHost
{
public:
    bool GetTimeInfo(utility::TimecodeFormat&, int&, int&) const override { return false; }
    bool GetTempo(utility::Tempo& tempo) const override
    {
        tempo.mTempo = 120.0;
        return true;
    }
    bool GetTransportState(bool&, bool&, bool&) const override { return false; }
};

class XAUProcessPath : public testing::TestWithParam<Path>
{
protected:
    void SetUp() override
    {
        InitializeMainThreadID();
        mFilter = XAUAudioFilter::Create(u"4:" +
                                         EncodeComponentID({GetParam().type, GetParam().subType, 0x7A656278, 0, 0}));
        ASSERT_TRUE(mFilter);
        const auto stereo =
            AudioFilterBusDescription::CreateStereo(u"Main", AudioFilterBusDescription::kBusType_Main);
        mFilter->RequestIOConfiguration({stereo.GetLayout()}, {stereo.GetLayout()});
        mFilter->SetAudioFilterHost(&mHost);
        mFilter->SetSampleRate(48000.0F);
        mFilter->SetBlockSize(kFrames);
        mFilter->SetMainTargetBus(stereo);
        if (GetParam().hasSideChain)
            mFilter->SetSideChainTargetBus(stereo);
        mFilter->SetUseChannelMap(true);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Input);
        mFilter->SetDefaultChannelMap(AudioFilter::kDirection_Output);
        mConnection = mFilter->GetAutomatedParameterChangeSignal().connect([this](int, float) { ++mHeard; });
    }

    void TearDown() override
    {
        if (!mFilter)
            return;
        mConnection.disconnect();
        // Messages that nobody has taken keep their filter, and a flush takes no more than the ring holds.
        for (int flush = 0; flush < 4096; ++flush)
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
        input[0].fill(1.0F);
        for (int block = 0; block < kBlocks; ++block)
        {
            ChannelFlags silent;
            const realtimeguard::Section section;
            mFilter->SetCurrentOffset(static_cast<long long>(block) * kFrames);
            mFilter->ProcessWithMapping(in.data(), out.data(), kFrames, ChannelFlags(), silent);
            if (out[0][kFrames - 1] != 0.0F)
                mHasSounded = true;
        }
        mDone = true;
    }

    zebtest::VariableGuard mUnits{"AUDIO_COMPONENT_PATH", ZEB_UNITS};
    Host mHost;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
    boost::signals2::connection mConnection;
    int mHeard = 0;
    bool mHasSounded = false;
    std::atomic<bool> mDone = false;
};

TEST_P(XAUProcessPath, NeitherAllocatesNorLocksNorCallsTheSystem)
{
    realtimeguard::AnnounceWhatIsMissing();
    realtimeguard::Reset();
    mFilter->Resume();
    std::thread process([this] { ProcessBlocks(); });
    for (int round = 0; !mDone; ++round)
    {
        mFilter->PostSetParameter(0, static_cast<float>(round % 100) / 100.0F);
        mFilter->OnUITimerTick();
        zebcore::threads::PumpMainThread();
    }
    process.join();
    mFilter->Suspend();
    EXPECT_EQ(realtimeguard::CountAll(), 0U) << realtimeguard::Report();
    EXPECT_TRUE(mHasSounded);
    EXPECT_TRUE(zebcore::threads::RunMainThreadUntil([this] { return mHeard > 0; }, 5000));
}

INSTANTIATE_TEST_SUITE_P(Units, XAUProcessPath,
                         testing::Values(Path{"Gain", kAudioUnitType_Effect, 0x7A676169, false},
                                         Path{"Delay", kAudioUnitType_Effect, 0x7A64656C, false},
                                         Path{"Mixer", kAudioUnitType_Mixer, 0x7A6D6978, true},
                                         Path{"Tone", kAudioUnitType_Effect, 0x7A746F6E, false}),
                         testing::PrintToStringParamName());

} // namespace
} // namespace zebaudiofilterhost::xau
