// Takes an arrangement, but does not tell the one that it has.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementAnswer] = 0;
}
