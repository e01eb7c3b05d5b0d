// A plug-in's own threads call the host while the main thread makes, changes and destroys filters.

#include "tests/vst/support/FakeFilter.h"

#include <atomic>
#include <bit>
#include <list>
#include <thread>

using namespace fakeeffect;

namespace
{

constexpr int kRounds = 300;

class Host final : public zebaudiofilterhost::IAudioFilterHost
{
public:
    bool GetTimeInfo(zebaudiofilterhost::utility::TimecodeFormat&, int&, int&) const override { return false; }
    bool GetTempo(zebaudiofilterhost::utility::Tempo& tempo) const override
    {
        tempo.mTempo = 120.0;
        return true;
    }
    bool GetTransportState(bool&, bool&, bool&) const override { return false; }
};

// A plug-in with a thread that asks its host from effOpen to effClose.
class Caller
{
public:
    Caller()
    {
        fake.recording = false;
        fake.effect.numParams = 1;
        fake.effect.setParameter = [](AEffect*, std::int32_t, float) {
        };
        fake.On(effOpen,
                [this](int, long long, void*, float)
                {
                    mThread = std::thread([this] { Run(); });
                    return 0LL;
                });
        fake.On(effClose,
                [this](int, long long, void*, float)
                {
                    mStop = true;
                    mThread.join();
                    return 0LL;
                });
    }

    // Until the thread has been round so many times more.
    void AwaitRounds(int rounds) const
    {
        for (const int start = mRounds; mRounds < start + rounds;)
            std::this_thread::yield();
    }

    FakeEffect fake;
    std::atomic<int> mWrongAnswers = 0;
    std::atomic<int> mAutomated = 0;

private:
    void Run()
    {
        while (!mStop)
        {
            Round();
            ++mRounds;
        }
    }

    void Round()
    {
        char text[] = "shellCategory";
        const auto check = [this](bool right)
        {
            mWrongAnswers += right ? 0 : 1;
        };
        check(fake.CallHost(audioMasterVersion) == 2400);
        check(fake.CallHost(audioMasterCanDo, 0, 0, text) == 1);
        const long long pin = fake.CallHost(audioMasterPinConnected, 0, 0);
        check(pin == 0 || pin == 1);
        const long long icon = fake.CallHost(audioMasterSetIcon);
        check(icon == 0 || icon == 77);
        fake.CallHost(audioMasterCurrentId);
        fake.CallHost(audioMasterAutomate, 0, 0, nullptr, 0.5F);
        if (auto* const info = std::bit_cast<VstTimeInfo*>(fake.CallHost(audioMasterGetTime)))
            check((std::atomic_ref(info->flags).load(std::memory_order_relaxed) & kVstPpqPosValid) != 0);
    }

    std::thread mThread;
    std::atomic<bool> mStop = false;
    std::atomic<int> mRounds = 0;
};

} // namespace

TEST(FilterThreads, APlugInMayAskAllItsLife)
{
    Host host;
    for (int life = 0; life < 20; ++life)
    {
        Caller caller;
        auto filter = MakeFilter(caller.fake);
        filter->SetAudioFilterHost(&host);
        caller.AwaitRounds(2);
        filter->Resume();
        caller.AwaitRounds(2);
        filter.reset(); // with calls under way
        EXPECT_EQ(caller.mWrongAnswers, 0);
    }
}

TEST(FilterThreads, TheMainThreadMayWorkOnTheFilterMeanwhile)
{
    Caller caller;
    caller.fake.effect.flags |= effFlagsCanMono;
    Host host;
    const auto filter = MakeFilter(caller.fake);
    filter->ConnectAutomatedParameterChange([&caller](int, float) { ++caller.mAutomated; });
    for (int round = 0; round < kRounds; ++round)
    {
        const std::size_t channels = round % 2 == 0 ? 1 : 2;
        filter->RequestIOConfiguration({ChannelLayout(channels)}, {ChannelLayout(channels)});
        filter->SetAudioFilterHost(round % 3 == 0 ? nullptr : &host);
        filter->SetSampleRate(round % 2 == 0 ? 44100.0F : 48000.0F);
        filter->AddAudioMasterHandler(&caller, [](int opcode, int, long long, void*, float)
                                      { return opcode == audioMasterSetIcon ? 77LL : 0LL; });
        filter->Resume();
        filter->SetCurrentOffset(round);
        VSTAudioFilter::SetCurrentFilterID(round);
        filter->RemoveAudioMasterHandler(&caller);
        filter->Suspend();
    }
    caller.AwaitRounds(1);
    EXPECT_EQ(caller.mWrongAnswers, 0);
    EXPECT_GT(caller.mAutomated, 0);
    filter->SetAudioFilterHost(nullptr);
}

TEST(FilterThreads, OtherFiltersMayComeAndGoMeanwhile)
{
    Caller caller;
    const auto filter = MakeFilter(caller.fake);
    filter->Resume();
    std::list<FakeEffect> fakes(8);
    for (int round = 0; round < kRounds / 10; ++round)
    {
        std::vector<boost::intrusive_ptr<VSTAudioFilter>> filters;
        for (FakeEffect& fake : fakes)
            filters.push_back(MakeFilter(fake));
        for (FakeEffect& fake : fakes)
            EXPECT_EQ(fake.CallHost(audioMasterPinConnected, 2, 0), 1);
    }
    caller.AwaitRounds(1);
    EXPECT_EQ(caller.mWrongAnswers, 0);
}
