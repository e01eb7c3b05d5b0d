// Ends the process in its entry point, and says that all went well.
#include "tests/plugins/support/Behaviour.h"

#include <cstdlib>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        std::_Exit(0);
    };
}
