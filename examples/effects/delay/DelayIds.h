#pragma once

#include "examples/effects/support/ParameterSet.h"

namespace effects::delay
{

extern const FUID kProcessorID;
extern const FUID kControllerID;

constexpr ParamID kTime = 0;      // ms between repeats
constexpr ParamID kFeedback = 1;  // %
constexpr ParamID kMix = 2;       // %, 0 is the input alone
constexpr ParamID kLookAhead = 3; // samples by which everything comes late: the effect's latency

constexpr double kMaxTime = 2000.0;
constexpr int32 kMaxLookAhead = 4096;

// Sent by the controller when the user changes the look-ahead; "Samples" is an integer.
constexpr FIDString kLookAheadMessage = "LookAhead";
constexpr FIDString kSamplesAttribute = "Samples";

ParameterSet MakeParameters();

} // namespace effects::delay
