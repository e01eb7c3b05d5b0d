#pragma once

#include "host/src/VST/interface/VST2Interface.h"

namespace vst2fixture
{

// What every entry point does. `entry` is its name.
zebaudiofilterhost::vst::AEffect* MakeInstance(const char* entry, zebaudiofilterhost::vst::audioMasterCallback host);

// The host that called an entry point last, null before.
zebaudiofilterhost::vst::audioMasterCallback LatestHost();

} // namespace vst2fixture
