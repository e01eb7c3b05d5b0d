// A plug-in's own threads call the host while the main thread makes, changes and destroys filters.

#include "tests/vst/support/FakeFilter.h"

#include <array>
#include <atomic>
#include <bit>
#include <chrono>
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
        ++mAsked;
        return true;
    }
    bool GetTransportState(bool&, bool&, bool&) const override { return false; }

    mutable std::atomic<int> mAsked = 0;
};

// Beyond any time that a thread is kept waiting.
constexpr std::chrono::seconds kPatience{20};

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
        Await([this, end = mRounds + rounds] { return mRounds >= end; });
    }

    // Until the thread has seen it.
    template <class Condition>
    void Await(Condition condition) const
    {
        const auto end = std::chrono::steady_clock::now() + kPatience;
        while (!condition() && std::chrono::steady_clock::now() < end)
            std::this_thread::yield();
        EXPECT_TRUE(condition());
    }

    FakeEffect fake;
    std::atomic<int> mWrongAnswers = 0;
    std::atomic<int> mAutomated = 0;
    std::atomic<int> mTimes = 0;      // how often there was a record of the time
    std::atomic<int> mHandled = 0;    // how often a handler answered
    std::atomic<int> mNotHandled = 0; // and how often there was none

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
        ++(icon == 77 ? mHandled : mNotHandled);
        fake.CallHost(audioMasterCurrentId);
        fake.CallHost(audioMasterAutomate, 0, 0, nullptr, 0.5F);
        if (auto* const info = std::bit_cast<VstTimeInfo*>(fake.CallHost(audioMasterGetTime)))
        {
            ++mTimes;
            check((std::atomic_ref(info->flags).load(std::memory_order_relaxed) & kVstPpqPosValid) != 0);
        }
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
        caller.Await([&caller] { return caller.mTimes > 1; });
        filter.reset(); // with calls under way
        EXPECT_EQ(caller.mWrongAnswers, 0);
        EXPECT_EQ(caller.fake.callsAfterClose, 0);
        EXPECT_EQ(caller.fake.host(caller.fake.Get(), audioMasterGetTime, 0, 0, nullptr, 0.0F), 0);
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
        if (round % 50 == 0) // the others come and go unseen, or under a call
            caller.Await([&caller, times = caller.mTimes + 2, handled = caller.mHandled + 2]
                         { return caller.mTimes >= times && caller.mHandled >= handled; });
        filter->RemoveAudioMasterHandler(&caller);
        filter->Suspend();
    }
    caller.Await([&caller, unanswered = caller.mNotHandled + 2] { return caller.mNotHandled >= unanswered; });
    EXPECT_EQ(caller.mWrongAnswers, 0);
    EXPECT_GT(caller.mAutomated, 0);
    filter->SetAudioFilterHost(nullptr);
}

// They share one record. Whichever came last, each member is one that the host has told.
TEST(FilterThreads, TwoMayAskForTheTimeAtOnce)
{
    constexpr int kQuestions = 5000;
    Host host;
    FakeEffect fake;
    fake.recording = false;
    const auto filter = MakeFilter(fake);
    filter->SetAudioFilterHost(&host);
    filter->SetSampleRate(48000.0F);
    filter->Resume();
    std::atomic<int> waiting = 2;
    std::atomic<int> wrong = 0;
    const auto ask = [&]
    {
        for (--waiting; waiting > 0;)
            std::this_thread::yield();
        for (int question = 0; question < kQuestions; ++question)
        {
            filter->SetCurrentOffset(question % 2 == 0 ? 0 : 24000);
            auto* const info = std::bit_cast<VstTimeInfo*>(fake.CallHost(audioMasterGetTime));
            const auto read = [](double& member)
            {
                return std::atomic_ref(member).load(std::memory_order_relaxed);
            };
            const double beat = read(info->ppqPos);
            const double position = read(info->samplePos);
            wrong +=
                (beat == 1.0 || beat == 2.0) && (position == 0.0 || position == 24000.0) && read(info->tempo) == 120.0
                    ? 0
                    : 1;
        }
    };
    std::array<std::thread, 2> threads{std::thread(ask), std::thread(ask)};
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(wrong, 0);
    EXPECT_EQ(host.mAsked, 2 * kQuestions);
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
