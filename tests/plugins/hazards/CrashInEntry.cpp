// Crashes in its entry point.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        raise(SIGSEGV);
    };
}
