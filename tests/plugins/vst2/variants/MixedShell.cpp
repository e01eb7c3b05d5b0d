// A shell of two effects with an instrument between them.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.isShell = true;
    behaviour.members = {{"Left Effect"}, {"Instrument", true}, {"Right Effect"}};
}
