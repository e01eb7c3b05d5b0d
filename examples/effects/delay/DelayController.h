#pragma once

#include "examples/effects/delay/DelayIds.h"
#include "examples/effects/support/Bases.h"

namespace effects::delay
{

// Passes a new look-ahead to the processor, then asks the host to read the latency anew.
class DelayController : public Controller
{
public:
    DelayController() : Controller(MakeParameters()) {}

    tresult PLUGIN_API setParamNormalized(ParamID id, ParamValue value) override;
};

} // namespace effects::delay
