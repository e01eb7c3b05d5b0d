#include "host/src/XAU/linux/src/ListenerTable.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gmock/gmock.h>

#include <array>
#include <atomic>
#include <ctime>
#include <memory>
#include <stdexcept>
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
        if (ear.mThrows)
            throw std::runtime_error("callback");
        if (ear.mDisposesOfItself)
            ear.Dispose();
    }

    AUEventListenerRef mListener = nullptr;
    std::vector<std::string> mHeard;
    bool mDisposesOfItself = false;
    bool mThrows = false;
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

// Far more than the queues hold.
TEST_F(ListenersTest, InAFloodNoGestureIsLostNorTheLastValueOfAnyParameter)
{
    constexpr int kFlood = 5000;
    Ear ear(0.0F);
    for (const AudioUnitParameterID id : {1U, 2U})
    {
        ear.Listen(Change(id));
        ear.Listen(Begin(id));
        ear.Listen(End(id));
    }
    for (int round = 0; round < kFlood; ++round)
        Set(1, static_cast<Float32>(round % 7));
    Notify(Begin(1));
    for (int round = 0; round < kFlood; ++round)
        Set(1, static_cast<Float32>(round % 7));
    Set(2, 8.0F);
    Set(1, 9.0F);
    Notify(End(1));
    for (int round = 0; round < kFlood; ++round)
    {
        Notify(Begin(2));
        Notify(End(2));
    }
    mClock.Pass(kInterval);
    const auto count = [&](const char* what)
    {
        return std::count(ear.mHeard.begin(), ear.mHeard.end(), what);
    };
    EXPECT_EQ(count("begin 1"), 1);
    EXPECT_EQ(count("end 1"), 1);
    EXPECT_EQ(count("begin 2"), kFlood);
    EXPECT_EQ(count("end 2"), kFlood);
    EXPECT_EQ(count("2=8"), 1);
    EXPECT_EQ(ear.mHeard.back(), "end 2");
    const auto begin = std::find(ear.mHeard.begin(), ear.mHeard.end(), "begin 1");
    const auto end = std::find(begin, ear.mHeard.end(), "end 1");
    EXPECT_NE(std::find(begin, end, "1=9"), end) << "the last value belongs into its gesture";
    const std::size_t heard = ear.mHeard.size();
    mClock.Pass(kInterval);
    EXPECT_EQ(ear.mHeard.size(), heard) << "nothing is heard twice";
}

TEST_F(ListenersTest, WhatIsLeftWhenACallbackThrowsIsHeardLater)
{
    Ear ear(0.0F);
    ear.Listen(Change(1));
    ear.mThrows = true;
    Set(1, 3.0F);
    Set(1, 4.0F);
    EXPECT_THROW(mClock.Pass(kInterval), std::runtime_error);
    ear.mThrows = false;
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=3", "1=4"));
}

TEST_F(ListenersTest, AUnitMayGoBeforeItsListeners)
{
    FakeUnit other;
    other.SetParameters({1}, 0.0F, 10.0F);
    AudioUnit gone = nullptr;
    ASSERT_EQ(AudioComponentInstanceNew(other.GetComponent(), &gone), noErr);
    Ear ear;
    AudioUnitEvent event = Change(1);
    ear.Listen(event);
    event.mArgument.mParameter.mAudioUnit = gone;
    ear.Listen(event);
    Notify(event);
    const AudioUnitParameter all = {gone, kAUParameterListener_AnyParameter, kAudioUnitScope_Global, 0};
    EXPECT_EQ(AUParameterListenerNotify(nullptr, nullptr, &all), noErr);
    AudioComponentInstanceDispose(gone);
    other.mThrowsIn = {"get parameter"};
    Set(1, 3.0F);
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=3")) << "the unit that is there";

    // Another one, which may lie where the first one lay.
    ASSERT_EQ(AudioComponentInstanceNew(other.GetComponent(), &gone), noErr);
    event.mArgument.mParameter.mAudioUnit = gone;
    Notify(event);
    mClock.Pass(kInterval);
    EXPECT_EQ(ear.mHeard.size(), 1U) << "nobody listens to it";
    ear.Listen(event);
    other.mThrowsIn.clear();
    Notify(event);
    mClock.Pass(kInterval);
    EXPECT_THAT(ear.mHeard, testing::ElementsAre("1=3", "1=0"));
    AudioComponentInstanceDispose(gone);
    mClock.Pass(kInterval);
    ear.Dispose();
}

// Nanoseconds of one call, among units that are listened to in so many parameters.
class ListenersCostTest : public ListenersTest
{
protected:
    struct Cost
    {
        double add;
        double tell;
    };

    // The best of several: somebody else may be busy.
    Cost Measure(AudioUnitParameterID parameters)
    {
        constexpr int kTries = 5;
        Cost best = {1e9, 1e9};
        for (int round = 0; round < kTries; ++round)
        {
            Ear ear;
            best.add = std::min(best.add, Time(parameters, [&](AudioUnitParameterID id) { ear.Listen(Change(id)); }));
            best.tell = std::min(best.tell, Time(500, [&](AudioUnitParameterID) { Notify(Change(1)); }));
        }
        return best;
    }

    template <typename Call>
    static double Time(AudioUnitParameterID rounds, const Call& call)
    {
        const double start = Now();
        for (AudioUnitParameterID round = 0; round < rounds; ++round)
            call(round);
        return (Now() - start) / rounds;
    }

    // Of this thread's work.
    static double Now()
    {
        timespec time = {};
        clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
        return static_cast<double>(time.tv_sec) * 1e9 + static_cast<double>(time.tv_nsec);
    }
};

// A look at every row would make the many more than a hundred times as expensive.
TEST_F(ListenersCostTest, ListeningAndTellingDoNotGetExpensiveWithManyParameters)
{
    constexpr double kMost = 30.0;
    const Cost few = Measure(64);
    const Cost many = Measure(8192);
    EXPECT_LT(many.add / few.add, kMost);
    EXPECT_LT(many.tell / few.tell, kMost);
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
class ListenerTableTest : public testing::Test
{
protected:
    static constexpr std::size_t kThings = 40; // more than the first array holds

    struct Slot
    {
        std::unique_ptr<ListenerRow> mRow;
        std::atomic<bool> mIsThere = false;
    };

    static AudioUnitEvent EventOf(std::size_t thing)
    {
        AudioUnitEvent event = {};
        event.mArgument.mParameter.mParameterID = static_cast<AudioUnitParameterID>(thing);
        return event;
    }

    void Read()
    {
        const auto look = [this](const ListenerRow& row)
        {
            ++mSeen;
            if (!static_cast<const Slot*>(row.mObject)->mIsThere)
                ++mWrong;
        };
        for (std::size_t thing = 0; !mIsOver; thing = (thing + 1) % kThings)
        {
            mTable->ForEach(EventOf(thing), look);
            if (thing == 0)
                mTable->ForEach(look);
            std::this_thread::yield(); // Remove waits for a moment without readers
        }
    }

    void Toggle(std::size_t thing)
    {
        Slot& slot = mSlots[thing];
        if (!slot.mRow)
        {
            slot.mIsThere = true;
            slot.mRow = std::make_unique<ListenerRow>(nullptr, EventOf(thing), &slot, nullptr);
            mTable->Append(*slot.mRow);
            return;
        }
        ListenerRow* const row = slot.mRow.get();
        mTable->Remove({&row, 1});
        slot.mIsThere = false;
        slot.mRow.reset();
    }

    std::shared_ptr<ListenerTable> mTable = std::make_shared<ListenerTable>();
    std::array<Slot, kThings> mSlots;
    std::atomic<bool> mIsOver = false;
    std::atomic<long> mWrong = 0;
    std::atomic<long> mSeen = 0;
};

TEST_F(ListenerTableTest, RowsAreVisitedInTheOrderOfRegistration)
{
    std::vector<std::unique_ptr<ListenerRow>> rows;
    std::vector<const ListenerRow*> expected;
    for (std::size_t row = 0; row < kThings; ++row)
    {
        rows.push_back(std::make_unique<ListenerRow>(nullptr, EventOf(row % 2), nullptr, nullptr));
        mTable->Append(*rows.back());
        if (row % 2 == 0)
            expected.push_back(rows.back().get());
    }
    std::vector<const ListenerRow*> visited;
    mTable->ForEach(EventOf(0), [&](const ListenerRow& row) { visited.push_back(&row); });
    EXPECT_EQ(visited, expected);
}

TEST_F(ListenerTableTest, ReadersSeeRowsThatAreThere)
{
    constexpr int kRounds = 4000;
    std::thread first([this] { Read(); });
    std::thread second([this] { Read(); });
    for (int round = 0; round < kRounds || mSeen == 0; ++round)
        Toggle(static_cast<std::size_t>(round * 7 + round / 3) % kThings);
    mIsOver = true;
    first.join();
    second.join();
    EXPECT_EQ(mWrong, 0);
    for (std::size_t thing = 0; thing < kThings; ++thing)
    {
        int count = 0;
        mTable->ForEach(EventOf(thing), [&](const ListenerRow&) { ++count; });
        EXPECT_EQ(count, mSlots[thing].mRow ? 1 : 0) << thing;
    }
}

} // namespace
} // namespace zebaudiofilterhost::xau
