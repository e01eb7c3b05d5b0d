#pragma once

#include <array>
#include <cstddef>
#include <limits>
#include <optional>
#include <string_view>

namespace vst2fixture
{

// Everything about a fixture that is a number. A binary is built with its own; a test may turn any of them while the
// binary is loaded. Switches are 0 or 1.
enum class Knob
{
    // module
    kMagic,
    kEntryNull,
    kVersion,  // what effGetVstVersion answers
    kCategory, // what effGetPlugCategory answers; kReal: an effect, a synth or a shell
               // what the instance says of itself
    kInputs,
    kOutputs,
    kParameterCount, // kReal: the number there is
    kProgramCount,   // kReal
    kLatency,
    kCanMono,
    kCanReplacing,
    kIsSynth,
    kChunks,
    kEditor,
    // arrangements
    kAcceptArrangements,    // 0: effSetSpeakerArrangement refuses
    kFollowArrangements,    // 1: the pins become those of an arrangement that was taken
    kArrangementAnswer,     // of effGetSpeakerArrangement
    kArrangementNull,       // 1: both pointers stay null, 2: that of the output
    kArrangementChannelsIn, // numChannels of what is returned; kReal: as it was set
    kArrangementChannelsOut,
    kArrangementType, // of both; kReal
                      // processing
    kGain,
    kTail,
    kProcessThrows,    // 1: std::runtime_error, 2: an int
    kParameterThrows,  // setParameter and getParameter: likewise
    kDispatcherThrows, // opcode that throws, -1: none, kReal: all but effClose and what a scan asks unguarded
    kTimeInProcess,    // 1: asks for the time in every block
    kThreadCalls,      // 1: between effMainsChanged 1 and 0 a thread of the plug-in's own calls the host
                       // further calls to the host, one of each kind
    kCallsInEntry,
    kCallsInOpen,
    kCallsInClose,
    kCallsWithoutEffect, // 1: the three above are made with a null effect
                         // texts
    kFullTexts,          // 1: every text fills the host's buffer, without a zero at the end
                         // chunks
    kChunkSize,          // what effGetChunk answers; kReal: the values
    kChunkNull,          // 1: effGetChunk leaves the pointer null
    kSetChunkAnswer,
    // editor
    kRectNull, // 1: effEditGetRect leaves the pointer null
    kRectLeft,
    kRectTop,
    kRectRight,
    kRectBottom,
    kSizeInOpen, // width asked for by audioMasterSizeWindow from within effEditOpen, 0 for none
    kEditOpenAnswer,
    kVendorAnswer, // of effVendorSpecific
    kCount
};

// Stands for "as things really are".
constexpr double kReal = std::numeric_limits<double>::infinity();

std::optional<Knob> KnobCalled(std::string_view name); // kLatency for "latency"

using KnobValues = std::array<double, static_cast<std::size_t>(Knob::kCount)>;
KnobValues HarmlessKnobs();

// What counts now. Any thread.
double Get(Knob knob);
int GetInt(Knob knob);
int GetInt(Knob knob, int real); // `real` for kReal
inline bool IsOn(Knob knob)
{
    return Get(knob) != 0.0;
}
void Set(Knob knob, double value);
void ResetKnobs(); // to what the binary is built with

} // namespace vst2fixture
