// The transport between threads. What ThreadSanitizer sees here decides whether the memory orders are right; without
// it the tests still find values that were torn, lost, repeated or reordered.

#include "host/src/VST3/src/ParameterChangeTransfer.h"

#include <gtest/gtest.h>

#include <array>
#include <atomic>
#include <thread>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Steinberg::int32;
using Steinberg::Vst::ParamID;

constexpr int kChanges = 30000;
constexpr int kWriters = 3;

// Value and offset say the same, so that halves of two changes show.
void AddNumbered(ParameterChangeTransfer& transfer, ParamID id, int writer, int number)
{
    const int32 tag = writer * kChanges + number;
    transfer.AddChange(id, tag + .125, tag);
}

// What the reader expects of each writer: whole changes, in the order in which they were written.
class OrderCheck
{
public:
    void See(double value, int32 offset)
    {
        ++mSeen;
        ASSERT_EQ(value, offset + .125);
        int& last = mLast.at(static_cast<std::size_t>(offset / kChanges));
        ASSERT_LT(last, offset % kChanges);
        last = offset % kChanges;
    }
    int GetSeen() const { return mSeen; }
    bool SawTheLastOf(int writer) const { return mLast.at(static_cast<std::size_t>(writer)) == kChanges - 1; }

private:
    std::array<int, kWriters> mLast{-1, -1, -1};
    int mSeen = 0;
};

void DrainByID(ParameterChangeTransfer& transfer, ParamID id, OrderCheck& check)
{
    double value = 0;
    for (int32 offset = 0; transfer.GetNextChange(id, value, offset);)
        check.See(value, offset);
}

TEST(ParameterTransportThreads, ManyWritersOfOneParameter)
{
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({7});
    std::atomic<int> running{kWriters};
    std::vector<std::jthread> writers;
    writers.reserve(kWriters);
    for (int writer = 0; writer < kWriters; ++writer)
        writers.emplace_back(
            [&, writer]
            {
                for (int number = 0; number < kChanges; ++number)
                    AddNumbered(transfer, 7, writer, number);
                running.fetch_sub(1, std::memory_order_release);
            });
    OrderCheck check;
    while (running.load(std::memory_order_acquire) != 0)
        DrainByID(transfer, 7, check);
    DrainByID(transfer, 7, check);
    EXPECT_FALSE(transfer.HasChanges());
    EXPECT_GE(check.GetSeen(), 100);
    const bool sawALast = check.SawTheLastOf(0) || check.SawTheLastOf(1) || check.SawTheLastOf(2);
    EXPECT_TRUE(sawALast) << "the newest change of all is never lost";
}

TEST(ParameterTransportThreads, NothingIsLostThatFits)
{
    // Each writer waits for its change to arrive, so that no ring ever overflows and every single one has to come.
    constexpr ParamID kIDs = 130;
    constexpr int kRounds = 1000;
    ParameterChangeTransfer transfer;
    std::vector<ParamID> ids;
    for (ParamID id = 0; id < kIDs; ++id)
        ids.push_back(id);
    transfer.SetParameterIDs(ids);
    std::array<std::atomic<int>, kWriters> arrived{};
    std::atomic<bool> stop{false};
    std::jthread reader(
        [&]
        {
            ParameterChanges changes;
            changes.SetMaxParameters(kIDs);
            while (!stop.load(std::memory_order_acquire))
            {
                changes.ClearQueue();
                transfer.TransferChangesTo(changes);
                for (int32 index = 0; index < changes.getParameterCount(); ++index)
                {
                    auto* queue = changes.getParameterData(index);
                    arrived.at(queue->getParameterId() % kWriters)
                        .fetch_add(queue->getPointCount(), std::memory_order_release);
                }
            }
        });
    std::vector<std::jthread> writers;
    writers.reserve(kWriters);
    for (int writer = 0; writer < kWriters; ++writer)
        writers.emplace_back(
            [&, writer]
            {
                const auto own = static_cast<unsigned int>(writer);
                for (int round = 0; round < kRounds; ++round)
                {
                    const ParamID slot = static_cast<ParamID>(round) * kWriters % (kIDs - kWriters);
                    transfer.AddChange(slot - slot % kWriters + own, .5, round);
                    while (arrived.at(own).load(std::memory_order_acquire) <= round)
                        std::this_thread::yield();
                }
            });
    writers.clear();
    stop.store(true, std::memory_order_release);
    for (const auto& count : arrived)
        EXPECT_EQ(count.load(std::memory_order_acquire), kRounds);
}

TEST(ParameterTransportThreads, NewIDsWhileOthersReadAndWrite)
{
    ParameterChangeTransfer transfer;
    transfer.SetParameterIDs({1, 2});
    std::atomic<bool> stop{false};
    std::vector<std::jthread> threads;
    threads.reserve(3);
    for (int writer = 0; writer < 2; ++writer)
        threads.emplace_back(
            [&, writer]
            {
                for (int number = 0; !stop.load(std::memory_order_relaxed); number = (number + 1) % kChanges)
                    AddNumbered(transfer, static_cast<ParamID>(1 + number % 4), writer, number);
            });
    threads.emplace_back(
        [&]
        {
            ParameterChanges changes;
            changes.SetMaxParameters(4);
            while (!stop.load(std::memory_order_relaxed))
            {
                changes.ClearQueue();
                transfer.TransferChangesTo(changes);
            }
        });
    ParameterChangeTransfer clone;
    for (ParamID round = 0; round < 400; ++round)
    {
        transfer.SetParameterIDs({1, 2, 3 + round % 3});
        transfer.CopyTo(clone);
    }
    stop.store(true, std::memory_order_relaxed);
    threads.clear();
    double value = 0;
    for (const ParamID id : {ParamID(1), ParamID(2), ParamID(3)})
        for (int32 offset = 0; clone.GetNextChange(id, value, offset);)
            ASSERT_EQ(value, offset + .125) << "copies are whole, too";
}

TEST(ParameterTransportThreads, ShapesFromSeveralThreads)
{
    ParameterChangeTransfer transfer;
    {
        std::vector<std::jthread> threads;
        threads.reserve(3);
        for (ParamID thread = 0; thread < 3; ++thread)
            threads.emplace_back(
                [&transfer, thread]
                {
                    for (ParamID round = 0; round < 300; ++round)
                    {
                        transfer.SetParameterIDs({7, 100 + thread, 200 + round});
                        transfer.AddChange(7, .5, 0);
                    }
                });
    }
    transfer.SetParameterIDs({7});
    transfer.AddChange(7, .75, 1);
    double value = 0;
    int32 offset = 0;
    ASSERT_TRUE(transfer.GetNextChange(7, value, offset));
    EXPECT_EQ(value, .75);
    EXPECT_FALSE(transfer.GetNextChange(7, value, offset));
}

} // namespace

} // namespace zebaudiofilterhost::vst3
