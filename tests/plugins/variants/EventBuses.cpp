// Event buses both ways, and an event written in every block.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.inputs.push_back({u"Notes", 0, kMain, kEvent});
    behaviour.outputs.push_back({u"Notes", 0, kMain, kEvent});
}
