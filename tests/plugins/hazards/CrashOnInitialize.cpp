// Crashes when its component is initialised.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atInitialize = []
    {
        raise(SIGSEGV);
    };
}
