// Has entry and exit, and no GetPluginFactory.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour&)
{
}
