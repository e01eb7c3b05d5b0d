// Never comes back from its entry point.
#include "tests/plugins/support/Behaviour.h"

#include <unistd.h>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        for (;;)
            pause();
    };
}
