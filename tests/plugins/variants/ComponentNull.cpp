// The factory says that it created the component, and gives none.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCreateComponentNull] = 1;
}
