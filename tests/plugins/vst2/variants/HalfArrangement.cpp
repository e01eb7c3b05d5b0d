// Takes an arrangement, and then tells only that of the input.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementNull] = 2;
}
