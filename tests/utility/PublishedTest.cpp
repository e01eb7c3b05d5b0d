#include "utility/src/Published.h"

#include <gtest/gtest.h>

#include <memory>
#include <thread>
#include <vector>

using zebaudiofilterhost::Published;

namespace
{

struct Counted
{
    explicit Counted(int& count) : mCount(&count) { ++*mCount; }
    ~Counted() { --*mCount; }
    Counted(const Counted&) = delete;
    Counted& operator=(const Counted&) = delete;

    int* mCount;
};

using Holder = std::shared_ptr<Counted>;

} // namespace

TEST(Published, ReplacedValueLivesAsLongAsAReader)
{
    int living = 0;
    {
        Published<Holder> published;
        published.Publish(std::make_shared<Counted>(living));
        {
            const Published<Holder>::Reader reader(published);
            published.Publish(std::make_shared<Counted>(living));
            published.FreeRetired();
            EXPECT_EQ(living, 2);
            EXPECT_NE(*reader, nullptr);
        }
        published.FreeRetired();
        EXPECT_EQ(living, 1);
        published.Publish({});
    }
    EXPECT_EQ(living, 0);
}

// Two that replace, two that read, one that frees: no reader sees a torn or a dead value.
TEST(Published, SurvivesManyThreads)
{
    constexpr int kRounds = 2000;
    Published<std::vector<int>> published;
    std::atomic<bool> torn = false;
    std::atomic<int> writers = 2;
    std::vector<std::thread> threads;
    for (int writer = 0; writer < 2; ++writer)
        threads.emplace_back(
            [&, writer]
            {
                for (int round = 0; round < kRounds; ++round)
                    published.Publish(std::vector<int>(static_cast<std::size_t>(round % 20), writer));
                --writers;
            });
    for (int reader = 0; reader < 2; ++reader)
        threads.emplace_back(
            [&]
            {
                while (writers > 0)
                {
                    const Published<std::vector<int>>::Reader values(published);
                    for (const int value : *values)
                        if (value != values->front())
                            torn = true;
                }
            });
    while (writers > 0)
        published.FreeRetired();
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_FALSE(torn);
}
