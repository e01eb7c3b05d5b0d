// Every text fills the buffer of this host to its last byte.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kFullTexts] = 1;
}
