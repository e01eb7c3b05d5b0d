// Behaves; tests put it on the permanent block list.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour&)
{
}
