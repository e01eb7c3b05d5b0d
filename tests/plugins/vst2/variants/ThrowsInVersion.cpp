// Throws when it is asked for its version.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kDispatcherThrows] = effGetVstVersion;
}
