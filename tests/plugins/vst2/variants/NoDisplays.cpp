// Gives no text for the values of its parameters.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.hasDisplay = false;
}
