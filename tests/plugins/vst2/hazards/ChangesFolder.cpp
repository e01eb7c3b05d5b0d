// Makes another folder the working directory within effOpen and whenever it gets sound. Takes a side-chain.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <cstdlib>
#include <unistd.h>

namespace
{

void Leave()
{
    if (chdir("/") != 0)
        std::abort();
}

} // namespace

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kInputs] = 4;
    behaviour[Knob::kAcceptArrangements] = 0;
    behaviour.atOpen = Leave;
    behaviour.atProcess = Leave;
}
