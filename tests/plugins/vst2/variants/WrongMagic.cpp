// Returns an instance that does not begin with the magic number.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kMagic] = kEffectMagic + 1;
}
