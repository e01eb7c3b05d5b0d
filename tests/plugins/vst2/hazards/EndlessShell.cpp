// A shell that never comes to its last member.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <unistd.h>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.isShell = true;
    behaviour.members = {{"Member"}};
    behaviour.atNextMember = []
    {
        usleep(1000); // not out of memory before a test gives up
    };
}
