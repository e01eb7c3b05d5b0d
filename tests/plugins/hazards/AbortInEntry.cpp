// Aborts in its entry point.
#include "tests/plugins/support/Behaviour.h"

#include <cstdlib>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        std::abort();
    };
}
