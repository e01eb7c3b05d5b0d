// A view that asks for another size while it is being attached.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kResizeInAttached] = 640;
}
