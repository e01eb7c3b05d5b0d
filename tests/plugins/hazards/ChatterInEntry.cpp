// Writes to both outputs for ever in its entry point.
#include "tests/plugins/support/Behaviour.h"

#include <cstdio>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        for (;;)
        {
            std::fputs("chatter on the output\n", stdout);
            std::fputs("chatter on the error output\n", stderr);
        }
    };
}
