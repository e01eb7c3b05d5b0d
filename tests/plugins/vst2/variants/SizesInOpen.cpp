// Asks for another size from within effEditOpen.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kSizeInOpen] = 640;
}
