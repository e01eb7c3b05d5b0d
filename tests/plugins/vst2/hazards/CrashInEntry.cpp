// Crashes in its entry point.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <csignal>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        raise(SIGSEGV);
    };
}
