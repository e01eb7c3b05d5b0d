// An instrument; tests put it on the permanent block list.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kIsSynth] = 1;
}
