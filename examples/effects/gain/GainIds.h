#pragma once

#include "examples/effects/support/ParameterSet.h"

namespace effects::gain
{

extern const FUID kProcessorID;
extern const FUID kControllerID;

constexpr ParamID kGain = 0;     // dB, its lowest value is silence
constexpr ParamID kBypass = 1;   // switch
constexpr ParamID kChannels = 2; // read-only: how many channels the processor was activated with

// Sent by the processor when it is activated; "Channels" is an integer.
constexpr FIDString kFormatMessage = "Format";
constexpr FIDString kChannelsAttribute = "Channels";

ParameterSet MakeParameters();

} // namespace effects::gain
