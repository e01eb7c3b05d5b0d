// The ring with a real producer and a real consumer.
#include "utility/ProcessMessageHandler.h"
#include "utility/ThreadUtils.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

namespace zebaudiofilterhost
{
namespace
{

constexpr int kMessages = 8000;

// Written by the process thread without any protection of its own: the ring must provide it.
struct Results
{
    std::vector<int> order;
    std::atomic<int> destroyed{0};
    std::atomic<int> destroyedElsewhere{0};
    int mainStages = 0;
};

class NumberedMessage : public Message
{
public:
    NumberedMessage(Results& results, int number) : mResults(results), mNumber(number) {}

    ~NumberedMessage() override
    {
        mResults.destroyed.fetch_add(1);
        if (!CurrentThreadIDIsMainThreadID())
            mResults.destroyedElsewhere.fetch_add(1);
    }

    bool ExecuteOnProcessThread() override
    {
        mResults.order.push_back(mNumber);
        return mNumber % 7 != 0;
    }

    bool ExecuteOnMainThread() override
    {
        ++mResults.mainStages;
        return true;
    }

private:
    Results& mResults;
    int mNumber;
};

TEST(MessageRingThreads, EveryMessageRunsOnceInOrderAndDiesOnTheMainThread)
{
    InitializeMainThreadID();
    Results results;
    results.order.reserve(kMessages);
    {
        ProcessMessageHandler handler;
        handler.SetProcessing(true);
        std::atomic<bool> stop{false};
        std::thread consumer(
            [&]
            {
                while (!stop.load())
                    handler.PumpFromProcessThread();
            });
        for (int number = 0; number < kMessages; ++number)
        {
            handler.Post(boost::intrusive_ptr<Message>(new NumberedMessage(results, number)));
            if (number % 16 == 0)
                handler.PumpFromMainThread();
        }
        while (results.destroyed.load() < kMessages)
            handler.PumpFromMainThread();
        stop = true;
        consumer.join();
    }
    ASSERT_EQ(results.order.size(), static_cast<std::size_t>(kMessages));
    for (int number = 0; number < kMessages; ++number)
        ASSERT_EQ(results.order[static_cast<std::size_t>(number)], number);
    EXPECT_EQ(results.mainStages, (kMessages + 6) / 7);
    EXPECT_EQ(results.destroyedElsewhere.load(), 0);
}

} // namespace
} // namespace zebaudiofilterhost
