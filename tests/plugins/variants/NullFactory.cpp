// GetPluginFactory gives nothing.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kFactoryIsNull] = 1;
}
