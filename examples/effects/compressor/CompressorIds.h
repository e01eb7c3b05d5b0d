#pragma once

#include "examples/effects/support/ParameterSet.h"

namespace effects::compressor
{

extern const FUID kProcessorID;
extern const FUID kControllerID;

constexpr ParamID kThreshold = 0; // dB
constexpr ParamID kRatio = 1;     // to 1
constexpr ParamID kAttack = 2;    // ms
constexpr ParamID kRelease = 3;   // ms
constexpr ParamID kMakeUp = 4;    // dB
constexpr ParamID kReduction = 5; // read-only, dB: written by the processor, for a meter

ParameterSet MakeParameters();

} // namespace effects::compressor
