// Crashes when asked for its factory.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atGetPluginFactory = []
    {
        raise(SIGSEGV);
    };
}
