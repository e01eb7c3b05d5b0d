// Gives a chunk of four megabytes.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kChunks] = 1;
    behaviour[Knob::kChunkSize] = 4.0 * 1024 * 1024;
}
