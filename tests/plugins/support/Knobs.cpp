#include "tests/plugins/support/Knobs.h"

#include "tests/plugins/support/Behaviour.h"

#include <algorithm>
#include <atomic>

namespace fixture
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
    {Knob::kEntryResult, "entryResult", 1},
    {Knob::kFactoryIsNull, "factoryIsNull", 0},
    {Knob::kFactoryInfoResult, "factoryInfoResult", 0},
    {Knob::kClassCount, "classCount", kReal},
    {Knob::kFailingClassInfo, "failingClassInfo", -1},
    {Knob::kCreateComponentResult, "createComponentResult", 0},
    {Knob::kCreateComponentNull, "createComponentNull", 0},
    {Knob::kCreateControllerResult, "createControllerResult", 0},
    {Knob::kRecordFactoryReferences, "recordFactoryReferences", 0},
    {Knob::kInitializeResult, "initializeResult", 0},
    {Knob::kControllerIDResult, "controllerIDResult", 0},
    {Knob::kControllerIDZero, "controllerIDZero", 0},
    {Knob::kBusCount, "busCount", kReal},
    {Knob::kBusInfoResult, "busInfoResult", 0},
    {Knob::kBusArrangementResult, "busArrangementResult", 0},
    {Knob::kFailingBus, "failingBus", -1},
    {Knob::kAcceptArrangements, "acceptArrangements", 1},
    {Knob::kLatency, "latency", 0},
    {Knob::kTail, "tail", 0},
    {Knob::kGain, "gain", 1},
    {Knob::kProcessResult, "processResult", 0},
    {Knob::kProcessThrows, "processThrows", 0},
    {Knob::kOutputSilence0, "outputSilence0", 0},
    {Knob::kOutputSilence1, "outputSilence1", 0},
    {Knob::kOutputValue, "outputValue", kReal},
    {Knob::kRestartInProcess, "restartInProcess", 0},
    {Knob::kEditsInProcess, "editsInProcess", 0},
    {Knob::kThreadEdits, "threadEdits", 0},
    {Knob::kThreadRestarts, "threadRestarts", 0},
    {Knob::kRecordContext, "recordContext", 0},
    {Knob::kPointsSeen, "pointsSeen", 0},
    {Knob::kPointSeenLast, "pointSeenLast", 0},
    {Knob::kControllerInitializeResult, "controllerInitializeResult", 0},
    {Knob::kParameterCount, "parameterCount", kReal},
    {Knob::kParameterInfoResult, "parameterInfoResult", 0},
    {Knob::kParameterStepCount, "parameterStepCount", kReal},
    {Knob::kUnitCount, "unitCount", kReal},
    {Knob::kProgramListCount, "programListCount", kReal},
    {Knob::kProgramCount, "programCount", kReal},
    {Knob::kStateSize, "stateSize", kReal},
    {Knob::kStateResult, "stateResult", 0},
    {Knob::kSetStateResult, "setStateResult", 0},
    {Knob::kSetComponentStateResult, "setComponentStateResult", 0},
    {Knob::kControllerStateSize, "controllerStateSize", 12},
    {Knob::kControllerStateResult, "controllerStateResult", 0},
    {Knob::kSetControllerStateResult, "setControllerStateResult", 0},
    {Knob::kViewWidth, "viewWidth", 400},
    {Knob::kViewHeight, "viewHeight", 300},
    {Knob::kAttachedResult, "attachedResult", 0},
    {Knob::kResizeInAttached, "resizeInAttached", 0},
    {Knob::kDirty, "dirty", 0},
    {Knob::kGainFocusResult, "gainFocusResult", 1},
    {Knob::kSetCurrentFocusResult, "setCurrentFocusResult", 1},
    {Knob::kTimerMilliseconds, "timerMilliseconds", 20},
    {Knob::kUnregisterInCallback, "unregisterInCallback", 0},
    {Knob::kLatencyFromTimer, "latencyFromTimer", 0},
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

std::string_view NameOf(Knob knob)
{
    return std::find_if(std::begin(kRows), std::end(kRows), [=](const Row& row) { return row.knob == knob; })->name;
}

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

} // namespace fixture
