// Throws at every opcode but those that a scan asks unguarded and effClose.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kDispatcherThrows] = kReal;
}
