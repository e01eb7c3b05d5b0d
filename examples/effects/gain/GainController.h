#pragma once

#include "examples/effects/gain/GainIds.h"
#include "examples/effects/support/Bases.h"

namespace effects::gain
{

// Shows gain and bypass, and how many channels the processor said it works on.
class GainController : public Controller
{
public:
    GainController() : Controller(MakeParameters()) {}

    tresult PLUGIN_API notify(IMessage* message) override;
};

} // namespace effects::gain
