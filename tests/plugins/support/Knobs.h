#pragma once

#include <array>
#include <cmath>
#include <cstddef>
#include <limits>
#include <optional>
#include <string_view>

namespace fixture
{

// Everything about a fixture that is a number. A bundle is built with its own defaults; a test may turn any of them
// while the bundle is loaded. Results are tresult values, 0 is success; switches are 0 or 1.
enum class Knob
{
    // module and factory
    kEntryResult,
    kFactoryIsNull,
    kFactoryInfoResult,
    kClassCount,       // what countClasses says; kReal: the number there is
    kFailingClassInfo, // index for which getClassInfo fails, -1 for none
    kCreateComponentResult,
    kCreateComponentNull, // success, and a null pointer
    kCreateControllerResult,
    kRecordFactoryReferences,
    // component
    kInitializeResult,
    kControllerIDResult,
    kControllerIDZero, // success, and an ID of zeros
    kBusCount,         // what getBusCount says for audio; kReal
    kBusInfoResult,
    kBusArrangementResult,
    kFailingBus,         // index that the two above are about, -1 for all
    kAcceptArrangements, // 0: setBusArrangements refuses and changes nothing
                         // processor
    kLatency,
    kTail,
    kGain, // what process multiplies by
    kProcessResult,
    kProcessThrows,  // 1: std::runtime_error, 2: an int
    kOutputSilence0, // silence flags that process sets on output bus 0
    kOutputSilence1,
    kOutputValue,      // normalized value that process writes for the read-only parameter, kReal: none
    kRestartInProcess, // flags of a restartComponent from within process, 0 for none
    kEditsInProcess,   // performEdit calls from within process
    kThreadEdits,      // 1: while processing, a thread of the plug-in's own calls performEdit
    kThreadRestarts,   // flags of restartComponent calls by such a thread, 0 for none
    kRecordContext,    // 1: records the process context with every block
    kPointsSeen,       // counts the points that process has got, without recording them
    kPointSeenLast,    // ID of the newest of them
                       // controller
    kControllerInitializeResult,
    kParameterCount, // what getParameterCount says; kReal
    kParameterInfoResult,
    kParameterStepCount, // step count of the program-change parameter, kReal: one less than the programs
    kUnitCount,
    kProgramListCount,
    kProgramCount,
    // state
    kStateSize, // bytes; kReal: the parameters
    kStateResult,
    kSetStateResult,
    kSetComponentStateResult,
    kControllerStateSize,
    kControllerStateResult,
    kSetControllerStateResult,
    // view
    kViewWidth,
    kViewHeight,
    kAttachedResult,
    kResizeInAttached, // width asked for by resizeView from within attached, 0 for none
                       // vendor-specific interfaces
    kDirty,
    kGainFocusResult,
    kSetCurrentFocusResult,
    // run loop
    kTimerMilliseconds,
    kUnregisterInCallback,
    kLatencyFromTimer, // announced at the first tick, 0 for none
    kCount
};

// Stands for "as things really are".
constexpr double kReal = std::numeric_limits<double>::infinity();

std::string_view NameOf(Knob knob); // "latency" for kLatency
std::optional<Knob> KnobCalled(std::string_view name);

using KnobValues = std::array<double, static_cast<std::size_t>(Knob::kCount)>;
KnobValues HarmlessKnobs();

// What counts now. Any thread.
double Get(Knob knob);
int GetInt(Knob knob);
inline bool IsOn(Knob knob)
{
    return Get(knob) != 0.0;
}
int GetInt(Knob knob, int real); // `real` for kReal
void Set(Knob knob, double value);
void ResetKnobs(); // to what the bundle is built with

} // namespace fixture
