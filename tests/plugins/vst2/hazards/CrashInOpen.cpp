// Crashes within effOpen.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <csignal>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atOpen = []
    {
        raise(SIGSEGV);
    };
}
