// Questions to another thread and answers back, as many as one asks for, in plain memory: what the rings and the
// states of messages do not order, ThreadSanitizer reports, and what they lose, repeat or reorder, the numbers show.
#include "tests/rings/MessageCount.h"
#include "utility/ProcessMessageHandler.h"
#include "utility/ThreadUtils.h"
#include "utility/src/MessageRingAccess.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <thread>

namespace zebaudiofilterhost
{

namespace
{

constexpr std::uint64_t kTravellers = 32; // as many as the ring holds: a full ring could change the order

struct Letter : Message
{
    std::uint64_t mQuestion = 0;
    std::uint64_t mAnswer = 0;
};

using LetterPtr = boost::intrusive_ptr<Letter>;

// One ring there and one back.
class Correspondence
{
public:
    explicit Correspondence(std::uint64_t count) : mCount(count)
    {
        for (LetterPtr& letter : mLetters)
            letter = LetterPtr(new Letter);
    }

    void AskAll()
    {
        std::uint64_t asked = 0;
        for (std::uint64_t answered = 0; answered < mCount; std::this_thread::yield())
        {
            for (; asked < mCount && asked < answered + kTravellers; ++asked)
            {
                const LetterPtr& letter = mLetters.at(asked % kTravellers);
                letter->mQuestion = asked;
                mWrongAnswers += mThere.Push(letter) ? 0U : 1U;
            }
            for (boost::intrusive_ptr<Message> back; mBack.Pop(back); ++answered)
                mWrongAnswers += static_cast<const Letter&>(*back).mAnswer == ~answered ? 0U : 1U;
        }
    }

    void AnswerAll()
    {
        for (std::uint64_t heard = 0; heard < mCount; std::this_thread::yield())
        {
            for (boost::intrusive_ptr<Message> message; mThere.Pop(message); ++heard)
            {
                auto& letter = static_cast<Letter&>(*message);
                mWrongQuestions += letter.mQuestion == heard ? 0U : 1U;
                letter.mAnswer = ~letter.mQuestion;
                mWrongQuestions += mBack.Push(message) ? 0U : 1U;
            }
        }
    }

    std::uint64_t GetWrong() const { return mWrongAnswers + mWrongQuestions; }

private:
    const std::uint64_t mCount;
    std::array<LetterPtr, kTravellers> mLetters;
    MessageRing mThere;
    MessageRing mBack;
    std::uint64_t mWrongAnswers = 0;   // of the one thread
    std::uint64_t mWrongQuestions = 0; // of the other
};

TEST(MessageRingLoad, LettersGoThereAndComeBack)
{
    Correspondence letters(testing::GetMessageCount());
    std::jthread other([&] { letters.AnswerAll(); });
    letters.AskAll();
    other.join();
    EXPECT_EQ(letters.GetWrong(), 0U);
}

struct Road
{
    std::uint64_t mCount;
    // The main thread's.
    std::uint64_t mAsked = 0;
    std::uint64_t mAnswered = 0;
    std::uint64_t mWrongAnswers = 0;
    // The process thread's, until it has ended.
    std::uint64_t mHeard = 0;
    std::uint64_t mWrongQuestions = 0;
};

// Goes back and forth, each time with another question, until all are asked.
class Traveller : public Message
{
public:
    explicit Traveller(Road& road) : mRoad(road), mQuestion(road.mAsked++) {}

    bool ExecuteOnProcessThread() override
    {
        if (mQuestion != mRoad.mHeard++)
            ++mRoad.mWrongQuestions;
        mAnswer = ~mQuestion;
        return false;
    }

    bool ExecuteOnMainThread() override
    {
        ++mRoad.mAnswered;
        if (mAnswer != ~mQuestion)
            ++mRoad.mWrongAnswers;
        if (mRoad.mAsked >= mRoad.mCount)
            return true;
        mQuestion = mRoad.mAsked++;
        return false;
    }

private:
    Road& mRoad;
    std::uint64_t mQuestion;
    std::uint64_t mAnswer = 0;
};

TEST(MessageRingLoad, AHandlersMessagesGoBackAndForth)
{
    InitializeMainThreadID();
    Road road{testing::GetMessageCount() / 10}; // Each costs a look at all the others
    ProcessMessageHandler handler;
    handler.SetProcessing(true);
    std::atomic<bool> stop{false};
    std::jthread process(
        [&]
        {
            for (; !stop.load(std::memory_order_relaxed); std::this_thread::yield())
                handler.PumpFromProcessThread();
        });
    for (std::uint64_t traveller = 0; traveller < kTravellers; ++traveller)
        handler.Post(boost::intrusive_ptr<Message>(new Traveller(road)));
    for (; road.mAnswered < road.mCount; std::this_thread::yield())
        handler.PumpFromMainThread();
    stop.store(true, std::memory_order_relaxed);
    process.join();
    EXPECT_EQ(road.mHeard, road.mCount);
    EXPECT_EQ(road.mAnswered, road.mCount);
    EXPECT_EQ(road.mWrongQuestions, 0U);
    EXPECT_EQ(road.mWrongAnswers, 0U);
}

} // namespace

} // namespace zebaudiofilterhost
