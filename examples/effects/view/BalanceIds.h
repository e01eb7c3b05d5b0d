#pragma once

#include "examples/effects/support/ParameterSet.h"

namespace effects::balance
{

extern const FUID kProcessorID;
extern const FUID kControllerID;

constexpr ParamID kBalance = 0; // %, -100 is left alone
constexpr ParamID kLevel = 1;   // read-only, peak of the last block, 0 to 1

ParameterSet MakeParameters();

} // namespace effects::balance
