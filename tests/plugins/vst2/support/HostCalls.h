#pragma once

#include "host/src/VST/interface/VST2Interface.h"

#include <string>
#include <string_view>

namespace vst2fixture
{

// The way to the host.
struct HostAccess
{
    zebaudiofilterhost::vst::audioMasterCallback host;
    zebaudiofilterhost::vst::AEffect* effect; // null: the call is made without one
};

// One call to the host by its published name, with what it answers as text. See README.md.
std::string CallHost(const HostAccess& access, const std::string& command);

// One call of every kind; the answers are recorded as "WHEN.audioMaster... answer".
void CallHostForEverything(const HostAccess& access, std::string_view when);

} // namespace vst2fixture
