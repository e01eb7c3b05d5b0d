// Three thousand parameters.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.parameters.resize(3000, {"Value", "Hz"});
}
