// Says that it has a chunk of a hundred bytes, and gives a null pointer.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kChunks] = 1;
    behaviour[Knob::kChunkSize] = 100;
    behaviour[Knob::kChunkNull] = 1;
}
