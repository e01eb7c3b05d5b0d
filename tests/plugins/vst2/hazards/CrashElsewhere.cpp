// Crashes when it gets sound, in another folder than the one it was loaded in.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <csignal>
#include <cstdlib>
#include <unistd.h>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atProcess = []
    {
        if (chdir("/") != 0)
            std::abort();
        raise(SIGSEGV);
    };
}
