#include "tests/plugins/vst2/support/Knobs.h"

#include "tests/plugins/vst2/support/Behaviour.h"

#include <algorithm>
#include <atomic>

namespace vst2fixture
{

namespace
{

struct Row
{
    Knob knob;
    std::string_view name;
    double harmless;
};

constexpr Row kRows[] = {
    {Knob::kMagic, "magic", kEffectMagic},
    {Knob::kEntryNull, "entryNull", 0},
    {Knob::kVersion, "version", 2400},
    {Knob::kCategory, "category", kReal},
    {Knob::kInputs, "inputs", 2},
    {Knob::kOutputs, "outputs", 2},
    {Knob::kParameterCount, "parameterCount", kReal},
    {Knob::kProgramCount, "programCount", kReal},
    {Knob::kLatency, "latency", 0},
    {Knob::kCanMono, "canMono", 0},
    {Knob::kCanReplacing, "canReplacing", 1},
    {Knob::kIsSynth, "isSynth", 0},
    {Knob::kChunks, "chunks", 0},
    {Knob::kEditor, "editor", 1},
    {Knob::kAcceptArrangements, "acceptArrangements", 1},
    {Knob::kFollowArrangements, "followArrangements", 1},
    {Knob::kArrangementAnswer, "arrangementAnswer", 1},
    {Knob::kArrangementNull, "arrangementNull", 0},
    {Knob::kArrangementChannelsIn, "arrangementChannelsIn", kReal},
    {Knob::kArrangementChannelsOut, "arrangementChannelsOut", kReal},
    {Knob::kArrangementType, "arrangementType", kReal},
    {Knob::kGain, "gain", 1},
    {Knob::kTail, "tail", 0},
    {Knob::kProcessThrows, "processThrows", 0},
    {Knob::kParameterThrows, "parameterThrows", 0},
    {Knob::kDispatcherThrows, "dispatcherThrows", -1},
    {Knob::kTimeInProcess, "timeInProcess", 0},
    {Knob::kThreadCalls, "threadCalls", 0},
    {Knob::kCallsInEntry, "callsInEntry", 0},
    {Knob::kCallsInOpen, "callsInOpen", 0},
    {Knob::kCallsInClose, "callsInClose", 0},
    {Knob::kCallsWithoutEffect, "callsWithoutEffect", 0},
    {Knob::kFullTexts, "fullTexts", 0},
    {Knob::kChunkSize, "chunkSize", kReal},
    {Knob::kChunkNull, "chunkNull", 0},
    {Knob::kSetChunkAnswer, "setChunkAnswer", 1},
    {Knob::kRectNull, "rectNull", 0},
    {Knob::kRectLeft, "rectLeft", 0},
    {Knob::kRectTop, "rectTop", 0},
    {Knob::kRectRight, "rectRight", 400},
    {Knob::kRectBottom, "rectBottom", 300},
    {Knob::kSizeInOpen, "sizeInOpen", 0},
    {Knob::kEditOpenAnswer, "editOpenAnswer", 1},
    {Knob::kVendorAnswer, "vendorAnswer", 1},
};
static_assert(std::size(kRows) == static_cast<std::size_t>(Knob::kCount));

using AtomicValues = std::array<std::atomic<double>, static_cast<std::size_t>(Knob::kCount)>;

void Fill(AtomicValues& values)
{
    const KnobValues& built = TheBehaviour().knobs;
    for (std::size_t i = 0; i < values.size(); ++i)
        values[i].store(built[i], std::memory_order_relaxed);
}

AtomicValues& Values()
{
    static AtomicValues sValues;
    [[maybe_unused]] static const bool sFilled = (Fill(sValues), true);
    return sValues;
}

} // namespace

std::optional<Knob> KnobCalled(std::string_view name)
{
    const auto row = std::find_if(std::begin(kRows), std::end(kRows),
                                  [=](const Row& candidate) { return candidate.name == name; });
    return row != std::end(kRows) ? std::optional(row->knob) : std::nullopt;
}

KnobValues HarmlessKnobs()
{
    KnobValues values{};
    for (const Row& row : kRows)
        values[static_cast<std::size_t>(row.knob)] = row.harmless;
    return values;
}

double Get(Knob knob)
{
    return Values()[static_cast<std::size_t>(knob)].load(std::memory_order_relaxed);
}

int GetInt(Knob knob)
{
    return static_cast<int>(Get(knob));
}

int GetInt(Knob knob, int real)
{
    const double value = Get(knob);
    return value == kReal ? real : static_cast<int>(value);
}

void Set(Knob knob, double value)
{
    Values()[static_cast<std::size_t>(knob)].store(value, std::memory_order_relaxed);
}

void ResetKnobs()
{
    Fill(Values());
}

} // namespace vst2fixture
