// Says that it has chunks, and takes none.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kChunks] = 1;
    behaviour[Knob::kSetChunkAnswer] = 0;
}
