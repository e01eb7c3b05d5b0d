#pragma once

#include "host/src/VST/interface/VST2Interface.h"

#include <string>

namespace vst2fixture
{

// One call of the host's dispatcher, or of ours to the host.
struct Call
{
    std::int32_t opcode;
    std::int32_t index;
    long long value;
    void* ptr;
    float opt;
};

// The call as the log has it: the opcode's published name and those arguments that it uses.
std::string CallLine(const Call& call);

// "audioMasterGetTime" and the like; -1 for a name that there isn't.
std::int32_t HostOpcode(const std::string& name);

// "type:channels:name of the first speaker", "-" for none.
std::string ArrangementText(const zebaudiofilterhost::vst::VstSpeakerArrangement* arrangement);

std::string HexText(std::uint32_t number);

} // namespace vst2fixture
