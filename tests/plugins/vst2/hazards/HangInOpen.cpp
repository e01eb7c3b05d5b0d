// Never comes back from effOpen.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <unistd.h>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atOpen = []
    {
        for (;;)
            pause();
    };
}
