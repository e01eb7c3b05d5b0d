#include "host/src/VST3/src/DirtySet.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

std::vector<std::size_t> TakeAll(DirtySet& set)
{
    std::vector<std::size_t> numbers;
    set.TakeAll([&](std::size_t number) { numbers.push_back(number); });
    return numbers;
}

TEST(DirtySet, TakesWhatWasAddedInOrder)
{
    struct Case
    {
        std::size_t mSize;
        std::vector<std::size_t> mNumbers; // ascending
    };
    const Case cases[] = {
        {0, {}},
        {1, {0}},
        {64, {0, 63}},
        {65, {63, 64}},
        {4096, {0, 64, 4095}},
        {4097, {0, 4095, 4096}},
        {300000, {0, 4096, 262143, 262144, 299999}},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mSize);
        DirtySet set(test.mSize);
        EXPECT_FALSE(set.MayHaveAny());
        const std::vector<std::size_t> descending(test.mNumbers.rbegin(), test.mNumbers.rend());
        for (const std::size_t number : descending)
        {
            set.Add(number);
            set.Add(number);
        }
        EXPECT_EQ(set.MayHaveAny(), !test.mNumbers.empty());
        EXPECT_EQ(TakeAll(set), test.mNumbers);
        EXPECT_FALSE(set.MayHaveAny());
        EXPECT_TRUE(TakeAll(set).empty());
    }
}

TEST(DirtySet, RemoveLeavesTheOthers)
{
    DirtySet set(10000);
    for (const std::size_t number : {5UL, 6UL, 700UL, 9000UL})
        set.Add(number);
    set.Remove(6);
    set.Remove(9000);
    set.Remove(8);
    EXPECT_EQ(TakeAll(set), (std::vector<std::size_t>{5, 700}));
    set.Add(9000);
    set.Remove(9000);
    EXPECT_FALSE(set.MayHaveAny());
}

// While one thread adds `added` and removes its neighbour 64 all the time, none of the rounds of 65 may get lost.
void ExpectNothingLost(std::size_t added)
{
    DirtySet set(5000);
    constexpr int kRounds = 5000;
    constexpr int kPatience = 100000;
    std::atomic<bool> stop{false};
    std::jthread nuisance(
        [&]
        {
            while (!stop.load(std::memory_order_relaxed))
            {
                set.Add(added);
                set.Remove(64);
            }
        });
    int seen = 0;
    for (int round = 0; round < kRounds && seen == round; ++round)
    {
        set.Add(65);
        // Removing the neighbour can put it out of sight, but only for a moment.
        for (int attempt = 0; seen == round && attempt < kPatience; ++attempt)
            set.TakeAll([&](std::size_t number) { seen += number == 65 ? 1 : 0; });
    }
    stop.store(true, std::memory_order_relaxed);
    EXPECT_EQ(seen, kRounds);
}

TEST(DirtySet, LosesNothingBetweenThreads)
{
    ExpectNothingLost(64);
    // Another leaf keeps the word above from becoming empty, and nothing heals the leaf of 65.
    ExpectNothingLost(200);
}

} // namespace

} // namespace zebaudiofilterhost::vst3
