#include "utility/ProcessMessageHandler.h"
#include "tests/utility/RecordingMessage.h"
#include "utility/ThreadUtils.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <stdexcept>
#include <thread>

namespace zebaudiofilterhost
{
namespace
{

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using testing::MessageLog;
using testing::RecordingMessage;

class ProcessMessageHandlerTest : public ::testing::Test
{
protected:
    ProcessMessageHandlerTest() { InitializeMainThreadID(); }

    boost::intrusive_ptr<RecordingMessage> Post(int number)
    {
        boost::intrusive_ptr<RecordingMessage> message(new RecordingMessage(mLog, number));
        mHandler.Post(message);
        return message;
    }

    void PostMany(int count)
    {
        for (int number = 0; number < count; ++number)
            Post(number);
    }

    static MessageLog Processed(int from, int to)
    {
        MessageLog log;
        for (int number = from; number < to; ++number)
            log.push_back("p" + std::to_string(number));
        return log;
    }

    MessageLog WithoutDestructions() const
    {
        MessageLog log;
        std::copy_if(mLog.begin(), mLog.end(), std::back_inserter(log),
                     [](const std::string& entry) { return entry.front() != 'd'; });
        return log;
    }

    MessageLog mLog;
    ProcessMessageHandler mHandler;
};

TEST_F(ProcessMessageHandlerTest, TheThirtyThirdMessageWaitsForTheSecondPump)
{
    PostMany(33);
    mHandler.PumpFromMainThread();
    EXPECT_EQ(WithoutDestructions(), Processed(0, 32));
    mHandler.PumpFromMainThread();
    EXPECT_EQ(WithoutDestructions(), Processed(0, 33));
}

TEST_F(ProcessMessageHandlerTest, OrderOfPostingHoldsAcrossAFullRing)
{
    PostMany(40);
    mHandler.PumpFromProcessThread(); // Makes room while eight still wait in the list
    Post(40);
    for (int pump = 0; pump < 3; ++pump)
        mHandler.PumpFromMainThread();
    EXPECT_EQ(WithoutDestructions(), Processed(0, 41));
}

TEST_F(ProcessMessageHandlerTest, MainStageRunsAtTheNextMainPumpOnly)
{
    mHandler.SetProcessing(true);
    Post(1)->mRefusalsOnProcessThread = 1;
    mHandler.PumpFromProcessThread();
    mHandler.PumpFromProcessThread();
    EXPECT_THAT(mLog, ElementsAre("p1"));
    mHandler.PumpFromMainThread();
    EXPECT_THAT(mLog, ElementsAre("p1", "m1", "d1"));
}

TEST_F(ProcessMessageHandlerTest, MessageGoesBackAndForthAsOftenAsItNeeds)
{
    const auto message = Post(1);
    message->mRefusalsOnProcessThread = 3;
    message->mRefusalsOnMainThread = 2;
    for (int pump = 0; pump < 3; ++pump)
        mHandler.PumpFromMainThread();
    EXPECT_THAT(mLog, ElementsAre("p1", "m1", "p1", "m1", "p1", "m1"));
    EXPECT_EQ(message->GetState(), Message::kState_Finished);
}

TEST_F(ProcessMessageHandlerTest, AMessageThatComesBackGoesAheadOfLaterOnes)
{
    Post(0);
    const auto message = Post(1);
    message->mRefusalsOnProcessThread = 1;
    message->mRefusalsOnMainThread = 1;
    Post(2);
    mHandler.PumpFromMainThread();
    Post(3);
    mHandler.PumpFromMainThread();
    EXPECT_THAT(WithoutDestructions(), ElementsAre("p0", "p1", "p2", "m1", "p1", "p3"));
}

TEST_F(ProcessMessageHandlerTest, MainPumpLeavesTheRingToTheProcessThread)
{
    mHandler.SetProcessing(true);
    Post(1);
    mHandler.PumpFromMainThread();
    EXPECT_THAT(mLog, IsEmpty());
    mHandler.PumpFromProcessThread();
    EXPECT_THAT(mLog, ElementsAre("p1"));
}

TEST_F(ProcessMessageHandlerTest, FinishedMessageStaysWhileTheCallerHoldsIt)
{
    auto message = Post(1);
    mHandler.PumpFromMainThread();
    mHandler.PumpFromMainThread();
    EXPECT_EQ(message->GetState(), Message::kState_Finished);
    EXPECT_EQ(message->GetRefCount(), 2);
    message.reset();
    EXPECT_THAT(mLog, ElementsAre("p1"));
    mHandler.PumpFromMainThread();
    EXPECT_THAT(mLog, ElementsAre("p1", "d1"));
}

TEST_F(ProcessMessageHandlerTest, FlushOffTheMainThreadOnlyRunsTheRing)
{
    Post(1)->mRefusalsOnProcessThread = 1;
    std::thread([this] { mHandler.FlushMessageQueue(); }).join();
    EXPECT_THAT(mLog, ElementsAre("p1"));
    mHandler.FlushMessageQueue();
    EXPECT_THAT(mLog, ElementsAre("p1", "m1", "d1"));
}

class CallingMessage : public Message
{
public:
    explicit CallingMessage(std::function<void()> call) : mCall(std::move(call)) {}
    bool ExecuteOnProcessThread() override { return false; }
    bool ExecuteOnMainThread() override
    {
        mCall();
        return true;
    }

private:
    std::function<void()> mCall;
};

TEST_F(ProcessMessageHandlerTest, AStageMayPostAndFlush)
{
    mHandler.Post(boost::intrusive_ptr<Message>(new CallingMessage(
        [this]
        {
            PostMany(20); // Moves the list
            mHandler.FlushMessageQueue();
        })));
    Post(20);
    mHandler.PumpFromMainThread();
    EXPECT_EQ(WithoutDestructions().size(), 21U);
}

// Fails in one of its stages, as often as it is run.
class ThrowingMessage : public RecordingMessage
{
public:
    ThrowingMessage(MessageLog& log, int number, bool onProcessThread)
        : RecordingMessage(log, number), mOnProcessThread(onProcessThread)
    {
    }

    bool ExecuteOnProcessThread() override
    {
        RecordingMessage::ExecuteOnProcessThread();
        if (mOnProcessThread)
            throw std::runtime_error("process stage");
        return false;
    }

    bool ExecuteOnMainThread() override
    {
        RecordingMessage::ExecuteOnMainThread();
        throw std::runtime_error("main stage");
    }

private:
    const bool mOnProcessThread;
};

TEST_F(ProcessMessageHandlerTest, AStageThatThrowsIsOverAndHoldsUpNobody)
{
    struct Case
    {
        bool onProcessThread;
        MessageLog byTheThrow;
        MessageLog inTheEnd;
    };
    for (const Case& each : {Case{true, {"p0", "p1"}, {"p0", "p1", "p2", "m2"}},
                             Case{false, {"p0", "p1", "p2", "m1"}, {"p0", "p1", "p2", "m1", "m2"}}})
    {
        mLog.clear();
        Post(0);
        mHandler.Post(boost::intrusive_ptr<Message>(new ThrowingMessage(mLog, 1, each.onProcessThread)));
        Post(2)->mRefusalsOnProcessThread = 1;
        EXPECT_THROW(mHandler.PumpFromMainThread(), std::runtime_error);
        EXPECT_EQ(WithoutDestructions(), each.byTheThrow);
        mHandler.PumpFromMainThread();
        EXPECT_EQ(WithoutDestructions(), each.inTheEnd);
        EXPECT_EQ(mLog.size(), each.inTheEnd.size() + 3) << "all three are gone";
    }
}

// The owner of a handler, held by a message in its own queue.
class Owner : public virtual zebcore::utility::RefCountedObject, public ProcessMessageHandler
{
public:
    explicit Owner(bool& dead) : mDead(dead) {}
    ~Owner() override { mDead = true; }

private:
    bool& mDead;
};

class HoldingMessage : public Message
{
public:
    explicit HoldingMessage(boost::intrusive_ptr<Owner> owner) : mOwner(std::move(owner)) {}

private:
    boost::intrusive_ptr<Owner> mOwner;
};

TEST_F(ProcessMessageHandlerTest, OwnerMayDieInItsOwnPurge)
{
    bool dead = false;
    boost::intrusive_ptr<Owner> owner(new Owner(dead));
    Owner* const raw = owner.get();
    for (int i = 0; i < 3; ++i)
        raw->Post(boost::intrusive_ptr<Message>(new HoldingMessage(owner)));
    owner.reset();
    EXPECT_FALSE(dead);
    raw->FlushMessageQueue();
    EXPECT_TRUE(dead);
}

} // namespace
} // namespace zebaudiofilterhost
