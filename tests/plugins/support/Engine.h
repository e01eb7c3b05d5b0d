#pragma once

#include "tests/plugins/support/OwnThread.h"

#include "examples/effects/support/Vst3.h"

namespace fixture
{

using namespace Steinberg;
using namespace Steinberg::Vst;

// What a fixture does in process: record the block, copy main input to main output times the gain, misbehave as the
// knobs say.
class Engine
{
public:
    tresult Process(ProcessData& data);

    // Starts or ends the plug-in's own thread.
    void SetProcessing(bool on);

private:
    OwnThread mThread;
};

} // namespace fixture
