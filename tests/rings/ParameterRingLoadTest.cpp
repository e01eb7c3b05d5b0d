// Changes of parameters from two writers to one reader, as many as one asks for. Each says in plain memory, too, that
// it is made: ThreadSanitizer reports it if a reader of the change could miss that.
#include "host/src/VST3/src/ParameterChangeTable.h"
#include "tests/rings/MessageCount.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <thread>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Steinberg::Vst::ParamID;

constexpr std::size_t kWriters = 2;
constexpr ParamID kIDs = 2;
// Of all writers together not more than a ring holds, so that none is ever full.
constexpr std::uint64_t kMostUnderWay = kMaxPointsPerParameter / kWriters;
constexpr std::uint64_t kWriterBit = std::uint64_t(1) << 48;

// The change of a number; its offset follows from it, so that parts of two changes show.
ParameterQueueValue MakeChange(std::size_t writer, std::uint64_t number)
{
    return {static_cast<double>(kWriterBit * writer + number), static_cast<Steinberg::int32>(number * 7)};
}

struct Writer
{
    std::atomic<std::uint64_t> mTaken{0};    // by the reader
    std::array<std::uint64_t, 128> mPlain{}; // more than can be under way, were they all of one ID
    // The reader's.
    std::array<std::uint64_t, kIDs> mLast{};
    std::uint64_t mCount = 0;
    std::uint64_t mWrong = 0;
};

class Load
{
public:
    explicit Load(std::uint64_t perWriter) : mPerWriter(perWriter) {}

    // Numbers count from 1; each ID gets every second one.
    void Write(std::size_t index, bool wait)
    {
        Writer& writer = mWriters.at(index);
        for (std::uint64_t number = 1; number <= mPerWriter; ++number)
        {
            while (wait && number > writer.mTaken.load(std::memory_order_acquire) + kMostUnderWay)
                std::this_thread::yield();
            if (wait)
                writer.mPlain.at(number % writer.mPlain.size()) = number;
            mTable.Write(static_cast<ParamID>(number % kIDs), MakeChange(index, number));
        }
        mRunning.fetch_sub(1, std::memory_order_release);
    }

    void ReadAll(bool isEveryOneToCome)
    {
        bool isRunning = true;
        while (isRunning)
        {
            std::this_thread::yield();
            isRunning = mRunning.load(std::memory_order_acquire) != 0; // asked before the last look
            mTable.TakeAll([&](ParamID id, const ParameterQueueValue& value) { See(id, value, isEveryOneToCome); });
            for (Writer& writer : mWriters)
                writer.mTaken.store(writer.mCount, std::memory_order_release);
        }
    }

    const std::array<Writer, kWriters>& GetWriters() const { return mWriters; }

private:
    void See(ParamID id, const ParameterQueueValue& value, bool isEveryOneToCome)
    {
        const auto bits = static_cast<std::uint64_t>(value.mValue);
        Writer& writer = mWriters.at(bits / kWriterBit);
        const std::uint64_t number = bits % kWriterBit;
        std::uint64_t& last = writer.mLast.at(id);
        bool isRight =
            number > last && number % kIDs == id && value.mSampleOffset == MakeChange(0, number).mSampleOffset;
        if (isEveryOneToCome)
            isRight = isRight && (last == 0 || number == last + kIDs) &&
                      writer.mPlain.at(number % writer.mPlain.size()) == number;
        writer.mWrong += isRight ? 0 : 1;
        ++writer.mCount;
        last = number;
    }

    const std::uint64_t mPerWriter;
    ParameterChangeTable mTable{{0, 1}};
    std::array<Writer, kWriters> mWriters;
    std::atomic<std::size_t> mRunning{kWriters};
};

void RunThrough(Load& load, bool wait)
{
    std::vector<std::jthread> writers;
    writers.reserve(kWriters);
    for (std::size_t writer = 0; writer < kWriters; ++writer)
        writers.emplace_back([&load, writer, wait] { load.Write(writer, wait); });
    load.ReadAll(wait);
}

TEST(ParameterRingLoad, EveryChangeArrivesWhileTheRingsHaveRoom)
{
    const std::uint64_t perWriter = testing::GetMessageCount() / kWriters;
    Load load(perWriter);
    RunThrough(load, true);
    for (const Writer& writer : load.GetWriters())
    {
        EXPECT_EQ(writer.mCount, perWriter);
        EXPECT_EQ(writer.mWrong, 0U);
    }
}

TEST(ParameterRingLoad, TheNewestArriveWhereTheRingsOverflow)
{
    const std::uint64_t perWriter = testing::GetMessageCount() / kWriters / 4;
    Load load(perWriter);
    RunThrough(load, false);
    std::array<std::uint64_t, kIDs> newest{};
    for (const Writer& writer : load.GetWriters())
    {
        EXPECT_EQ(writer.mWrong, 0U);
        for (ParamID id = 0; id < kIDs; ++id)
            newest.at(id) = std::max(newest.at(id), writer.mLast.at(id));
    }
    // Whoever was the last to write has left its last change.
    EXPECT_EQ(std::max(newest[0], newest[1]), perWriter);
}

} // namespace

} // namespace zebaudiofilterhost::vst3
