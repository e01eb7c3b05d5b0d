// Crashes when a component is created.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atCreate = []
    {
        raise(SIGSEGV);
    };
}
