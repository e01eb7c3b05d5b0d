#pragma once

#include "utility/CommonTypes.h"

#include <pluginterfaces/base/ipluginbase.h>

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The first class of the factory with this ID, of whatever category. False if there is none. [main]
bool FindClass(Steinberg::IPluginFactory& factory, const Steinberg::TUID classID, Steinberg::PClassInfo& info);

/// Filter IDs of the audio classes, in factory order; controllers and the like are left out. [main]
std::vector<UTF16String> ListAudioClasses(Steinberg::IPluginFactory& factory);

} // namespace zebaudiofilterhost::vst3
