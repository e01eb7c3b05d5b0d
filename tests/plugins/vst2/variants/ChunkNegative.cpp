// Gives a chunk of less than no bytes.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kChunks] = 1;
    behaviour[Knob::kChunkSize] = -1;
}
