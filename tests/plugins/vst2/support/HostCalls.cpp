#include "tests/plugins/vst2/support/HostCalls.h"

#include "tests/plugins/support/Recorder.h"
#include "tests/plugins/vst2/support/CallLine.h"

#include <array>
#include <sstream>
#include <vector>

namespace vst2fixture
{

namespace
{

using namespace zebaudiofilterhost::vst;

using Words = std::vector<std::string>;

long long Make(const HostAccess& access, const Call& call)
{
    return access.host(access.effect, call.opcode, call.index, call.value, call.ptr, call.opt);
}

std::string WordAt(const Words& words, std::size_t index)
{
    return index < words.size() ? words[index] : "0";
}

// Hexadecimal numbers too.
long long NumberAt(const Words& words, std::size_t index)
{
    return std::stoll(WordAt(words, index), nullptr, 0);
}

std::string AskText(const HostAccess& access, std::int32_t opcode)
{
    std::array<char, 64> text{};
    text.fill('?');
    const long long answer = Make(access, {opcode, 0, 0, text.data(), 0.0F});
    const std::string_view all(text.data(), text.size());
    return std::to_string(answer) + ' ' + std::string(all.substr(0, all.find('\0')));
}

std::string AskTime(const HostAccess& access)
{
    const long long answer = Make(access, {audioMasterGetTime, 0, 0, nullptr, 0.0F});
    const auto* time = reinterpret_cast<const VstTimeInfo*>(answer);
    if (time == nullptr)
        return "0";
    std::string line;
    const auto add = [&](const char* name, auto value)
    {
        fixture::AddWord(line += (line.empty() ? "" : " ") + std::string(name) + '=', value);
    };
    add("flags", HexText(static_cast<std::uint32_t>(time->flags)));
    add("samples", time->samplePos);
    add("rate", time->sampleRate);
    add("ppq", time->ppqPos);
    add("bar", time->barStartPos);
    add("tempo", time->tempo);
    add("numerator", time->timeSigNumerator);
    add("denominator", time->timeSigDenominator);
    add("smpte", time->smpteFrameRate);
    add("nanos", time->nanoSeconds > 0.0 ? 1 : 0);
    return line;
}

// Without a text the pointer is null.
std::string AskCanDo(const HostAccess& access, const Words& words)
{
    std::string text = WordAt(words, 1);
    return std::to_string(Make(access, {audioMasterCanDo, 0, 0, words.size() > 1 ? text.data() : nullptr, 0.0F}));
}

// INDEX, and 1 for a place that a 64-bit number may be written to: that number is the second word of the answer.
std::string AskVendorSpecific(const HostAccess& access, const Words& words)
{
    long long number = -1;
    const auto index = static_cast<std::int32_t>(NumberAt(words, 1));
    const bool hasPlace = NumberAt(words, 2) != 0;
    const long long answer = Make(access, {audioMasterVendorSpecific, index, 0, hasPlace ? &number : nullptr, 0.0F});
    return HexText(static_cast<std::uint32_t>(answer)) + (hasPlace ? ' ' + std::to_string(number) : "");
}

} // namespace

std::string CallHost(const HostAccess& access, const std::string& command)
{
    std::istringstream stream(command);
    Words words;
    for (std::string word; stream >> word;)
        words.push_back(word);
    const std::int32_t opcode = words.empty() ? -1 : HostOpcode(words.front());
    switch (opcode)
    {
    case -1:
        return "unknown";
    case audioMasterGetVendorString:
    case audioMasterGetProductString:
        return AskText(access, opcode);
    case audioMasterGetTime:
        return AskTime(access);
    case audioMasterCanDo:
        return AskCanDo(access, words);
    case audioMasterVendorSpecific:
        return AskVendorSpecific(access, words);
    default:
        return std::to_string(Make(access, {opcode, static_cast<std::int32_t>(NumberAt(words, 1)), NumberAt(words, 2),
                                            nullptr, std::stof(WordAt(words, 3))}));
    }
}

void CallHostForEverything(const HostAccess& access, std::string_view when)
{
    for (const char* command : {"audioMasterVersion",
                                "audioMasterCurrentId",
                                "audioMasterGetVendorString",
                                "audioMasterGetProductString",
                                "audioMasterGetVendorVersion",
                                "audioMasterVendorSpecific 0x2e903f43",
                                "audioMasterVendorSpecific 0x70400000",
                                "audioMasterVendorSpecific 0x70400000 1",
                                "audioMasterCanDo",
                                "audioMasterCanDo shellCategory",
                                "audioMasterCanDo sendVstTimeInfo",
                                "audioMasterCanDo sizeWindow",
                                "audioMasterCanDo sendVstEvents",
                                "audioMasterGetLanguage",
                                "audioMasterGetTime",
                                "audioMasterPinConnected 0 0",
                                "audioMasterPinConnected 0 1",
                                "audioMasterPinConnected 0 2",
                                "audioMasterAutomate 0 0 0.5",
                                "audioMasterBeginEdit 0",
                                "audioMasterEndEdit 0",
                                "audioMasterSizeWindow 300 200",
                                "audioMasterGetSampleRate",
                                "audioMasterGetBlockSize",
                                "audioMasterIOChanged",
                                "audioMasterUpdateDisplay",
                                "audioMasterIdle"})
        fixture::Record(std::string(when) + '.' + command, "->", CallHost(access, command));
}

} // namespace vst2fixture
