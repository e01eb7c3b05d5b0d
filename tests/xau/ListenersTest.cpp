#include "host/src/XAU/linux/src/ListenerTable.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gmock/gmock.h>

#include <atomic>
#include <thread>

namespace zebaudiofilterhost::xau
{
namespace
{

constexpr unsigned int kInterval = 50; // milliseconds

// A listener that writes down what it hears.
class Ear
{
public:
    explicit Ear(float granularity = 10.0F) : mThread(std::this_thread::get_id())
    {
        EXPECT_EQ(AUEventListenerCreate(Hear, this, CFRunLoopGetCurrent(), kCFRunLoopDefaultMode, 0.05F, granularity,
                                        &mListener),
                  noErr);
    }
    ~Ear() { Dispose(); }
    Ear(const Ear&) = delete;
    Ear& operator=(const Ear&) = delete;

    void Dispose()
    {
        if (mListener)
            AUListenerDispose(std::exchange(mListener, nullptr));
    }

    void Listen(const AudioUnitEvent& event) { AUEventListenerAddEventType(mListener, this, &event); }

    static void Hear(void* userData, void* object, const AudioUnitEvent* event, UInt64, Float32 value)
    {
        auto& ear = *static_cast<Ear*>(userData);
        EXPECT_EQ(object, &ear);
        EXPECT_EQ(std::this_thread::get_id(), ear.mThread);
        const std::string id = std::to_string(event->mArgument.mParameter.mParameterID);
        const std::string number = std::to_string(static_cast<int>(value));
        ear.mHeard.push_back(event->mEventType == kAudioUnitEvent_ParameterValueChange          ? id + "=" + number
                             : event->mEventType == kAudioUnitEvent_BeginParameterChangeGesture ? "begin " + id
                                                                                                : "end " + id);
        if (ear.mDisposesOfItself)
            ear.Dispose();
    }

    AUEventListenerRef mListener = nullptr;
    std::vector<std::string> mHeard;
    bool mDisposesOfItself = false;
    std::thread::id mThread;
};

class ListenersTest : public testing::Test
{
protected:
    void SetUp() override
    {
        mUnit.SetParameters({1, 2}, 0.0F, 10.0F);
        ASSERT_EQ(AudioComponentInstanceNew(mUnit.GetComponent(), &mInstance), noErr);
    }
    void TearDown() override { AudioComponentInstanceDispose(mInstance); }

    AudioUnitEvent Event(AudioUnitEventType type, AudioUnitParameterID id) const
    {
        AudioUnitEvent event = {};
        event.mEventType = type;
        event.mArgument.mParameter = {mInstance, id, kAudioUnitScope_Global, 0};
        return event;
    }
    AudioUnitEvent Change(AudioUnitParameterID id) const { return Event(kAudioUnitEvent_ParameterValueChange, id); }
    AudioUnitEvent Begin(AudioUnitParameterID id) const
    {
        return Event(kAudioUnitEvent_BeginParameterChangeGesture, id);
    }
    AudioUnitEvent End(AudioUnitParameterID id) const { return Event(kAudioUnitEvent_EndParameterChangeGesture, id); }

    void Set(AudioUnitParameterID id, Float32 value, AUEventListenerRef sender = nullptr) const
    {
        const AudioUnitParameter parameter = {mInstance, id, kAudioUnitScope_Global, 0};
        EXPECT_EQ(AUParameterSet(sender, nullptr, &parameter, value, 0), noErr);
    }
    static void Notify(const AudioUnitEvent& event) { AUEventListenerNotify(nullptr, nullptr, &event); }

    TestClock mClock;
    FakeUnit mUnit;
    AudioUnit mInstance = nullptr;
};

TEST_F(ListenersTest, ChangesAreHeardOnceAnIntervalAndTheLastOneOnly)
{
    Ear ear;
    ear.Listen(Change(1));
    ear.Listen(Change(1)); // no second time
    Set(1, 3.0F);
    Set(1, 4.0F);
    Set(2, 9.0F);
    mClock.Pass(kInterval - 1);
    EXPECT_THAT(ear.mHeard, testing::IsEmpty());
    mClock.Pass(1);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=4"));
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=4"));
}

TEST_F(ListenersTest, WithoutAGranularityEveryChangeIsHeard)
{
    Ear ear(0.0F);
    ear.Listen(Change(1));
    Set(1, 3.0F);
    Set(1, 4.0F);
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=3", "1=4"));
}

TEST_F(ListenersTest, GesturesStandBetweenTheChangesThatTheyEnclose)
{
    Ear ear;
    ear.Listen(Change(1));
    ear.Listen(Begin(1));
    ear.Listen(End(1));
    Set(1, 1.0F);
    Notify(Begin(1));
    Set(1, 2.0F);
    Set(1, 3.0F);
    Notify(End(1));
    Notify(Begin(2)); // of another parameter: not listened to
    Set(1, 4.0F);
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=1", "begin 1", "1=3", "end 1", "1=4"));
}

TEST_F(ListenersTest, ANotificationOfAllParametersReachesEachThatIsListenedTo)
{
    Ear ear;
    ear.Listen(Change(1));
    ear.Listen(Change(2));
    ear.Listen(Begin(1));
    mUnit.mValues[{kAudioUnitScope_Global, 1}] = 5.0F;
    mUnit.mValues[{kAudioUnitScope_Global, 2}] = 6.0F;
    const AudioUnitParameter all = {mInstance, kAUParameterListener_AnyParameter, kAudioUnitScope_Part, 7};
    EXPECT_EQ(AUParameterListenerNotify(nullptr, nullptr, &all), noErr);
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::UnorderedElementsAre("1=5", "2=6"));
}

TEST_F(ListenersTest, TheSenderAndTheSilencedHearNothing)
{
    Ear sender;
    Ear other;
    sender.Listen(Change(1));
    other.Listen(Change(1));
    Set(1, 3.0F, sender.mListener);
    mClock.Pass(kInterval);
    EXPECT_THAT(sender.mHeard, testing::IsEmpty());
    EXPECT_THAT(other.mHeard, testing::ElementsAre("1=3"));

    Set(1, 4.0F);
    const AudioUnitEvent event = Change(1);
    AUEventListenerRemoveEventType(other.mListener, &other, &event); // what waits already is not heard either
    mClock.Pass(kInterval);
    EXPECT_THAT(other.mHeard, testing::ElementsAre("1=3"));
    EXPECT_THAT(sender.mHeard, testing::ElementsAre("1=4"));
}

TEST_F(ListenersTest, AListenerMayGoInItsCallback)
{
    Ear ear(0.0F);
    Ear other(0.0F);
    ear.mDisposesOfItself = true;
    ear.Listen(Change(1));
    other.Listen(Change(1));
    Set(1, 3.0F);
    Set(1, 4.0F);
    mClock.Pass(kInterval);
    Set(1, 5.0F);
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=3"));
    EXPECT_THAT(other.mHeard, testing::ElementsAre("1=3", "1=4", "1=5"));
}

TEST_F(ListenersTest, WhatIsLostInAFloodIsHeardByItsLastValue)
{
    Ear ear;
    ear.Listen(Change(1));
    ear.Listen(Change(2));
    for (int round = 0; round < 5000; ++round)
        Set(1, static_cast<Float32>(round % 7));
    Set(2, 8.0F);
    Set(1, 9.0F);
    mClock.Pass(kInterval);
    ASSERT_FALSE(ear.mHeard.empty());
    EXPECT_THAT(ear.mHeard, testing::Contains("2=8"));
    EXPECT_EQ(*std::find_if(ear.mHeard.rbegin(), ear.mHeard.rend(),
                            [](const std::string& heard) { return heard[0] == '1'; }),
              "1=9");
}

TEST_F(ListenersTest, ChangesOfOtherThreadsAreHeardOnTheListenersOwn)
{
    Ear ear(0.0F);
    ear.Listen(Change(1));
    std::thread([&] { Notify(Change(1)); }).join();
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=0"));
}

TEST_F(ListenersTest, AForeignThreadHearsInItsOwnLoop)
{
    std::vector<std::string> heard;
    std::thread(
        [&]
        {
            EXPECT_EQ(CFRunLoopRunInMode(kCFRunLoopDefaultMode, 10.0, 0), kCFRunLoopRunFinished);
            Ear ear;
            ear.Listen(Change(1));
            Set(1, 6.0F);
            EXPECT_EQ(CFRunLoopRunInMode(kCFRunLoopDefaultMode, 10.0, 1), kCFRunLoopRunHandledSource);
            EXPECT_EQ(CFRunLoopRunInMode(kCFRunLoopDefaultMode, 0.0, 0), kCFRunLoopRunTimedOut);
            heard = ear.mHeard;
        })
        .join();
    EXPECT_THAT(heard, testing::ElementsAre("1=6"));
}

// Rows come and go on one thread while others tell of changes: nobody may see a row that has gone.
TEST(ListenerTable, ReadersSeeWholeRowsOfListenersThatAreThere)
{
    constexpr int kRounds = 2000;
    ListenerTable table;
    std::array<std::atomic<bool>, 4> isThere = {};
    std::atomic<bool> isOver = false;
    std::atomic<long> wrong = 0;
    std::atomic<long> seen = 0;
    const auto listenerOf = [&](std::size_t index)
    {
        return reinterpret_cast<AUListenerBase*>(&isThere[index]);
    };
    const auto read = [&]
    {
        while (!isOver)
        {
            table.ForEach(
                [&](const ListenerTable::Row& row)
                {
                    ++seen;
                    if (row.mInterest.mObject != row.mListener ||
                        !*reinterpret_cast<const std::atomic<bool>*>(row.mListener))
                        ++wrong;
                });
            std::this_thread::yield(); // Remove waits for a moment without readers
        }
    };
    std::thread first(read);
    std::thread second(read);
    for (int round = 0; round < kRounds || seen == 0; ++round)
    {
        const std::size_t index = static_cast<std::size_t>(round) % isThere.size();
        isThere[index] = true;
        for (int row = 0; row < 10; ++row) // more than the first array holds
            table.Append(listenerOf(index), {{}, listenerOf(index)});
        if (round % 3 == 0)
            continue;
        const std::size_t out = static_cast<std::size_t>(round / 2) % isThere.size();
        table.Remove([&](const ListenerTable::Row& row) { return row.mListener == listenerOf(out); });
        isThere[out] = false;
        std::size_t left = 0;
        table.ForEach([&](const ListenerTable::Row& row) { left += row.mListener == listenerOf(out) ? 1U : 0U; });
        ASSERT_EQ(left, 0U);
    }
    isOver = true;
    first.join();
    second.join();
    EXPECT_EQ(wrong, 0);
}

} // namespace
} // namespace zebaudiofilterhost::xau
