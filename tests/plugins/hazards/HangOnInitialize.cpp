// Never comes back from initialising its component.
#include "tests/plugins/support/Behaviour.h"

#include <unistd.h>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atInitialize = []
    {
        for (;;)
            pause();
    };
}
