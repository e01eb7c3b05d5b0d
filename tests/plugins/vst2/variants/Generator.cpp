// An effect of the highest category, that of generators.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCategory] = kPlugCategGenerator;
}
