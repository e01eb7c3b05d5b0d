// Changes a parameter from inside process, three times a block.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kEditsInProcess] = 3;
}
