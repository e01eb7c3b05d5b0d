// What it costs one thread to put something into a ring and to take it out again, and to find nothing in it.
#include "benchmarks/rings/Rings.h"

#include <benchmark/benchmark.h>

#include <array>
#include <memory>
#include <string>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebaudiofilterhost::benchmarks;

constexpr std::size_t kBurst = 16;   // in the ring at once
constexpr std::size_t kPolls = 1024; // a poll alone is too short to be timed

std::array<MessagePtr, kBurst> MakeValues(const MessagePtr& /*kind*/)
{
    std::array<MessagePtr, kBurst> messages;
    for (MessagePtr& message : messages)
        message = MessagePtr(new Message);
    return messages;
}

std::array<ParameterQueueValue, kBurst> MakeValues(const ParameterQueueValue& /*kind*/)
{
    std::array<ParameterQueueValue, kBurst> changes;
    for (std::size_t index = 0; index < kBurst; ++index)
        changes.at(index) = {1. / static_cast<double>(index + 3), 0}; // as all are that come from the host
    return changes;
}

bool IsSame(const MessagePtr& one, const MessagePtr& other)
{
    return one == other;
}

bool IsSame(const ParameterQueueValue& one, const ParameterQueueValue& other)
{
    return one.mValue == other.mValue && one.mSampleOffset == other.mSampleOffset;
}

// Everything comes out once and in order, more often than the ring has places, and then nothing.
template <class Ring, class Value>
bool IsRight(Ring& ring, const std::array<Value, kBurst>& values)
{
    Value out;
    for (int round = 0; round < 100; ++round)
    {
        for (const Value& value : values)
            if (!ring.Push(value))
                return false;
        for (const Value& value : values)
            if (!ring.Pop(out) || !IsSame(out, value))
                return false;
        if (ring.Pop(out))
            return false;
    }
    return true;
}

template <class Ring, class Value>
void PushAndPop(benchmark::State& state)
{
    const auto ring = std::make_unique<Ring>();
    const std::array<Value, kBurst> values = MakeValues(Value());
    if (!IsRight(*ring, values))
        state.SkipWithError("the ring loses or changes what goes through it");
    Value out;
    for ([[maybe_unused]] auto round : state)
    {
        for (const Value& value : values)
            benchmark::DoNotOptimize(ring->Push(value));
        for (std::size_t index = 0; index < kBurst; ++index)
        {
            benchmark::DoNotOptimize(ring->Pop(out));
            benchmark::DoNotOptimize(out);
        }
    }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(kBurst));
}

template <class Ring, class Value>
void PollEmpty(benchmark::State& state)
{
    const auto ring = std::make_unique<Ring>();
    if (!IsRight(*ring, MakeValues(Value())))
        state.SkipWithError("the ring loses or changes what goes through it");
    Value out;
    for ([[maybe_unused]] auto round : state)
        for (std::size_t poll = 0; poll < kPolls; ++poll)
        {
            benchmark::DoNotOptimize(ring->Pop(out));
            benchmark::ClobberMemory();
        }
    state.SetItemsProcessed(state.iterations() * static_cast<std::int64_t>(kPolls));
}

template <class Ring, class Value>
void Register(const std::string& row, const std::string& way)
{
    benchmark::RegisterBenchmark((row + "/work:push-pop/way:" + way).c_str(), PushAndPop<Ring, Value>);
    benchmark::RegisterBenchmark((row + "/work:empty-poll/way:" + way).c_str(), PollEmpty<Ring, Value>);
}

} // namespace

int main(int argc, char** argv)
{
    for (const char* way : {"ours", "again"})
    {
        Register<OurMessages, MessagePtr>("P6/message", way);
        Register<OurChanges, ParameterQueueValue>("P6/parameter", way);
    }
    Register<BoostRing<MessagePtr, 32>, MessagePtr>("P6/message", "spsc");
    Register<BoostRing<ParameterQueueValue, 100>, ParameterQueueValue>("P6/parameter", "spsc");
    Register<MoodycamelRing<MessagePtr, 32>, MessagePtr>("P6/message", "other");
    Register<MoodycamelRing<ParameterQueueValue, 100>, ParameterQueueValue>("P6/parameter", "other");
    Register<BoostQueue<ParameterQueueValue, 100>, ParameterQueueValue>("P6/parameter", "many-writers");
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
}
