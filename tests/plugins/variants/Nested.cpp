// Behaves; lies in a folder of its own, as makers of many plug-ins arrange it.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour&)
{
}
