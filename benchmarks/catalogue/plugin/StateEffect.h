#pragma once

#include "examples/effects/support/Bases.h"

#include <vector>

namespace effects::state
{

// Keeps whatever bytes it was given as its state; before that, as many as the variable ZEB_STATE_BYTES says. Its
// sound is its input, and it leaves denormal numbers switched off behind each block, as some effects do.
class StateProcessor : public Processor
{
public:
    StateProcessor();

    tresult PLUGIN_API getControllerClassId(TUID classID) override;
    tresult PLUGIN_API process(ProcessData& data) override;
    tresult PLUGIN_API setState(IBStream* state) override;
    tresult PLUGIN_API getState(IBStream* state) override;

private:
    std::vector<char> mState;
};

// Has no parameters, and lets the component's state lie.
class StateController : public Controller
{
public:
    StateController() : Controller(ParameterSet{}) {}

    tresult PLUGIN_API setComponentState(IBStream*) override { return kResultOk; }
};

} // namespace effects::state
