// Crashes when it gets sound.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <csignal>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atProcess = []
    {
        raise(SIGSEGV);
    };
}
