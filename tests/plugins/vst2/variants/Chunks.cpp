// Keeps its state in chunks.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kChunks] = 1;
}
