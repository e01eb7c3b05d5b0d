// Units that go on one thread while listeners of another one listen to them.
#include "host/src/XAU/linux/src/AUListener.h"
#include "host/src/XAU/linux/src/ListenerTable.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <future>
#include <memory>
#include <thread>
#include <vector>

namespace zebaudiofilterhost::xau
{
namespace
{

constexpr unsigned int kTimerInterval = 50; // milliseconds

AudioUnitEvent ChangeOf(AudioUnit unit, AudioUnitParameterID id)
{
    AudioUnitEvent event = {};
    event.mEventType = kAudioUnitEvent_ParameterValueChange;
    event.mArgument.mParameter = {unit, id, kAudioUnitScope_Global, 0};
    return event;
}

void CountUp(void* userData, void*, const AudioUnitEvent*, UInt64, Float32)
{
    ++*static_cast<std::atomic<int>*>(userData);
}

// A table that is closed while somebody stands in the middle of telling, with a row before him.
class HeldTableTest : public testing::Test
{
protected:
    HeldTableTest()
    {
        for (const AudioUnitParameterID id : {1U, 2U})
            mListener->Add(ChangeOf(nullptr, id), nullptr, mTable);
        mTable->ForEach([this](ListenerRow& row) { mRows.push_back(row.weak_from_this()); });
        mTeller = std::thread(
            [this]
            {
                mTable->ForEach(ChangeOf(nullptr, 1),
                                [this](ListenerRow& row)
                                {
                                    mStands.set_value();
                                    mGoesOn.get_future().wait();
                                    row.mListener->Tell(row, 0, 1.0F);
                                    mIsTold = true;
                                });
            });
        mStands.get_future().wait();
        mCloser = std::thread([this] { mTable->Close(); });
        while (!mTable->IsClosed())
            std::this_thread::yield();
    }

    ~HeldTableTest() override
    {
        if (mTeller.joinable())
            LetGo();
    }

    void LetGo()
    {
        mGoesOn.set_value();
        mTeller.join();
        mCloser.join();
    }

    void Pass()
    {
        for (int pass = 0; pass < 3; ++pass)
            mClock.Pass(kTimerInterval);
    }

    auto CountRows() const
    {
        return std::count_if(mRows.begin(), mRows.end(),
                             [](const std::weak_ptr<ListenerRow>& row) { return !row.expired(); });
    }

    TestClock mClock;
    std::atomic<int> mHeard = 0;
    std::shared_ptr<ListenerTable> mTable = std::make_shared<ListenerTable>();
    std::unique_ptr<AUListenerBase> mListener = std::make_unique<AUListenerBase>(
        CountUp, &mHeard, CFRunLoopGetCurrent(), AUListenerBase::Seconds(kTimerInterval / 1000.0),
        AUListenerBase::Seconds(0));
    std::vector<std::weak_ptr<ListenerRow>> mRows;
    std::promise<void> mStands;
    std::promise<void> mGoesOn;
    std::atomic<bool> mIsTold = false;
    std::thread mTeller;
    std::thread mCloser;
};

TEST_F(HeldTableTest, RowsStayUntilNobodyLooksAtThemAnyMore)
{
    mListener->LoseUnit(); // another of its units goes meanwhile
    Pass();
    EXPECT_EQ(CountRows(), 2);
    LetGo();
    Pass();
    EXPECT_EQ(CountRows(), 0) << "also what was told last must not keep them";
    EXPECT_EQ(mHeard, 0) << "of a unit that has gone";
}

TEST_F(HeldTableTest, AListenerStaysUntilNobodyLooksAtItAnyMore)
{
    mListener->LoseUnit();
    mClock.Pass(kTimerInterval);
    std::promise<void> goes;
    std::thread release(
        [&]
        {
            goes.get_future().wait();
            LetGo();
        });
    goes.set_value();
    mListener.reset();
    EXPECT_TRUE(mIsTold);
    release.join();
    EXPECT_EQ(CountRows(), 0);
}

// Everything that a worker listens to goes on the main thread; its listener then passes, hears, or goes itself.
class WorkersListenerTest : public testing::Test
{
protected:
    static constexpr int kUnits = 6;
    static constexpr AudioUnitParameterID kParameters = 20; // more than the first array of a table holds

    WorkersListenerTest()
    {
        std::vector<AudioUnitParameterID> ids;
        for (AudioUnitParameterID id = 0; id < kParameters; ++id)
            ids.push_back(id);
        mUnit.SetParameters(ids, 0.0F, 1.0F);
    }

    void Open()
    {
        mInstances.resize(kUnits);
        for (AudioUnit& instance : mInstances)
            ASSERT_EQ(AudioComponentInstanceNew(mUnit.GetComponent(), &instance), noErr);
    }

    // `passes` of the worker's loop from the moment on when the first unit may go.
    void Listen(int passes)
    {
        AUEventListenerRef listener = nullptr;
        EXPECT_EQ(AUEventListenerCreate(CountUp, &mHeard, CFRunLoopGetCurrent(), kCFRunLoopDefaultMode, 0.001F, 0.0F,
                                        &listener),
                  noErr);
        for (AudioUnit instance : mInstances)
        {
            for (AudioUnitParameterID id = 0; id < kParameters; ++id)
            {
                const AudioUnitEvent event = ChangeOf(instance, id);
                EXPECT_EQ(AUEventListenerAddEventType(listener, nullptr, &event), noErr);
            }
        }
        mListens.set_value();
        for (int pass = 0; pass < passes; ++pass)
            CFRunLoopRunInMode(kCFRunLoopDefaultMode, 1.0, 1);
        EXPECT_EQ(AUListenerDispose(listener), noErr);
    }

    void Round(int passes)
    {
        mListens = std::promise<void>();
        Open();
        std::thread worker([this, passes] { Listen(passes); });
        mListens.get_future().wait();
        for (AudioUnit instance : mInstances)
        {
            for (AudioUnitParameterID id = 0; id < kParameters; ++id)
            {
                const AudioUnitEvent event = ChangeOf(instance, id);
                AUEventListenerNotify(nullptr, nullptr, &event);
            }
            AudioComponentInstanceDispose(instance);
        }
        worker.join();
    }

    TestClock mClock;
    FakeUnit mUnit;
    std::vector<AudioUnit> mInstances;
    std::promise<void> mListens;
    std::atomic<int> mHeard = 0;
};

TEST_F(WorkersListenerTest, UnitsMayGoWhileTheListenerPassesOrGoes)
{
    constexpr int kRounds = 60;
    for (int round = 0; round < kRounds; ++round)
        Round(round % 4);
    EXPECT_LE(mHeard, kRounds * kUnits * static_cast<int>(kParameters)) << "nothing is heard twice";
}

} // namespace
} // namespace zebaudiofilterhost::xau
