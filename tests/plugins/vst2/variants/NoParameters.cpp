// No parameters and no programs.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.parameters.clear();
    behaviour.programs.clear();
}
