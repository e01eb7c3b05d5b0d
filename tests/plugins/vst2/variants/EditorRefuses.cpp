// Answers effEditOpen with 0, as many plug-ins do.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kEditOpenAnswer] = 0;
}
