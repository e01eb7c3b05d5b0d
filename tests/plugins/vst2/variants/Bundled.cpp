// Behaves, and lies in a bundle of its own.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour&)
{
}
