// Never comes back from its entry point.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <unistd.h>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        for (;;)
            pause();
    };
}
