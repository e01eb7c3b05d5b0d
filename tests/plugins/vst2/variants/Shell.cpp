// Three effects in one binary.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.isShell = true;
    behaviour.members = {{"First Member"}, {"Second Member"}, {"Third Member"}};
}
