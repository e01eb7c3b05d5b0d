#include "tests/plugins/vst2/support/CallLine.h"

#include "tests/plugins/support/Recorder.h"
#include "tests/plugins/vst2/FixtureID.h"

#include <array>
#include <charconv>
#include <cstring>
#include <map>

namespace vst2fixture
{

namespace
{

using namespace zebaudiofilterhost::vst;
using fixture::AddWord;

enum class Uses
{
    kNothing,
    kIndex,
    kValue,
    kOpt,
    kText,
    kPointer,
    kArrangements,
    kChunk,
    kVendor
};

struct Row
{
    const char* name;
    Uses uses = Uses::kNothing;
};

const Row& RowOf(std::int32_t opcode)
{
    static const Row sUnknown{"opcode"};
    static const std::map<std::int32_t, Row> sRows{
        {effOpen, {"effOpen"}},
        {effClose, {"effClose"}},
        {effSetProgram, {"effSetProgram", Uses::kValue}},
        {effGetProgram, {"effGetProgram"}},
        {effSetProgramName, {"effSetProgramName", Uses::kText}},
        {effGetProgramName, {"effGetProgramName"}},
        {effGetParamLabel, {"effGetParamLabel", Uses::kIndex}},
        {effGetParamDisplay, {"effGetParamDisplay", Uses::kIndex}},
        {effGetParamName, {"effGetParamName", Uses::kIndex}},
        {effSetSampleRate, {"effSetSampleRate", Uses::kOpt}},
        {effSetBlockSize, {"effSetBlockSize", Uses::kValue}},
        {effMainsChanged, {"effMainsChanged", Uses::kValue}},
        {effEditGetRect, {"effEditGetRect"}},
        {effEditOpen, {"effEditOpen", Uses::kPointer}},
        {effEditClose, {"effEditClose"}},
        {effEditIdle, {"effEditIdle"}},
        {effGetChunk, {"effGetChunk", Uses::kIndex}},
        {effSetChunk, {"effSetChunk", Uses::kChunk}},
        {effProcessEvents, {"effProcessEvents"}},
        {effCanBeAutomated, {"effCanBeAutomated", Uses::kIndex}},
        {effGetProgramNameIndexed, {"effGetProgramNameIndexed", Uses::kIndex}},
        {effGetPlugCategory, {"effGetPlugCategory"}},
        {effSetSpeakerArrangement, {"effSetSpeakerArrangement", Uses::kArrangements}},
        {effGetEffectName, {"effGetEffectName"}},
        {effGetVendorString, {"effGetVendorString"}},
        {effGetProductString, {"effGetProductString"}},
        {effVendorSpecific, {"effVendorSpecific", Uses::kVendor}},
        {effCanDo, {"effCanDo", Uses::kText}},
        {effGetTailSize, {"effGetTailSize"}},
        {effGetParameterProperties, {"effGetParameterProperties", Uses::kIndex}},
        {effGetVstVersion, {"effGetVstVersion"}},
        {effGetSpeakerArrangement, {"effGetSpeakerArrangement"}},
        {effShellGetNextPlugin, {"effShellGetNextPlugin"}},
        {effStartProcess, {"effStartProcess"}},
        {effStopProcess, {"effStopProcess"}},
    };
    const auto found = sRows.find(opcode);
    return found != sRows.end() ? found->second : sUnknown;
}

template <class... Words>
std::string Line(const char* name, const Words&... words)
{
    std::string line = name;
    ((line += ' ', AddWord(line, words)), ...);
    return line;
}

} // namespace

std::string HexText(std::uint32_t number)
{
    std::array<char, 16> text{};
    return "0x" + std::string(text.data(), std::to_chars(text.data(), text.data() + text.size(), number, 16).ptr);
}

std::string ArrangementText(const VstSpeakerArrangement* arrangement)
{
    if (arrangement == nullptr)
        return "-";
    const char* name = arrangement->speakers[0].name;
    std::string text;
    AddWord(text, arrangement->type);
    AddWord(text += ':', arrangement->numChannels);
    AddWord(text += ':', std::string_view(name, strnlen(name, sizeof(arrangement->speakers[0].name))));
    return text;
}

std::string CallLine(const Call& call)
{
    const auto& [name, uses] = RowOf(call.opcode);
    switch (uses)
    {
    case Uses::kIndex:
        return Line(name, call.index);
    case Uses::kValue:
        return Line(name, call.value);
    case Uses::kOpt:
        return Line(name, call.opt);
    case Uses::kText:
        return Line(name, call.ptr != nullptr ? static_cast<const char*>(call.ptr) : "-");
    case Uses::kPointer:
        return Line(name, call.ptr != nullptr ? 1 : 0);
    case Uses::kArrangements:
        return Line(name, ArrangementText(reinterpret_cast<const VstSpeakerArrangement*>(call.value)),
                    ArrangementText(static_cast<const VstSpeakerArrangement*>(call.ptr)));
    case Uses::kChunk:
        return Line(name, call.index, call.value,
                    "hash=" + std::to_string(zebtest::VST2FixtureID(
                                  {static_cast<const char*>(call.ptr), static_cast<std::size_t>(call.value)})));
    case Uses::kVendor:
        return Line(name, HexText(static_cast<std::uint32_t>(call.index)), call.value, call.opt);
    case Uses::kNothing:
        break;
    }
    return std::string_view(name) == "opcode" ? Line(name, call.opcode) : name;
}

std::int32_t HostOpcode(const std::string& name)
{
    static const std::map<std::string, std::int32_t> sNames{
        {"audioMasterAutomate", audioMasterAutomate},
        {"audioMasterVersion", audioMasterVersion},
        {"audioMasterCurrentId", audioMasterCurrentId},
        {"audioMasterIdle", audioMasterIdle},
        {"audioMasterPinConnected", audioMasterPinConnected},
        {"audioMasterWantMidi", audioMasterWantMidi},
        {"audioMasterGetTime", audioMasterGetTime},
        {"audioMasterProcessEvents", audioMasterProcessEvents},
        {"audioMasterTempoAt", audioMasterTempoAt},
        {"audioMasterGetNumAutomatableParameters", audioMasterGetNumAutomatableParameters},
        {"audioMasterIOChanged", audioMasterIOChanged},
        {"audioMasterSizeWindow", audioMasterSizeWindow},
        {"audioMasterGetSampleRate", audioMasterGetSampleRate},
        {"audioMasterGetBlockSize", audioMasterGetBlockSize},
        {"audioMasterGetCurrentProcessLevel", audioMasterGetCurrentProcessLevel},
        {"audioMasterGetVendorString", audioMasterGetVendorString},
        {"audioMasterGetProductString", audioMasterGetProductString},
        {"audioMasterGetVendorVersion", audioMasterGetVendorVersion},
        {"audioMasterVendorSpecific", audioMasterVendorSpecific},
        {"audioMasterSetIcon", audioMasterSetIcon},
        {"audioMasterCanDo", audioMasterCanDo},
        {"audioMasterGetLanguage", audioMasterGetLanguage},
        {"audioMasterGetDirectory", audioMasterGetDirectory},
        {"audioMasterUpdateDisplay", audioMasterUpdateDisplay},
        {"audioMasterBeginEdit", audioMasterBeginEdit},
        {"audioMasterEndEdit", audioMasterEndEdit},
    };
    const auto found = sNames.find(name);
    return found != sNames.end() ? found->second : -1;
}

} // namespace vst2fixture
