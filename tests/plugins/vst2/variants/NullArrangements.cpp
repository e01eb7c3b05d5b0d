// Takes an arrangement, and then tells two null pointers.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementNull] = 1;
}
