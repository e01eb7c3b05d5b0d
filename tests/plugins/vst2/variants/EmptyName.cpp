// Has no name of its own, nor a vendor.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.name.clear();
    behaviour.vendor.clear();
}
