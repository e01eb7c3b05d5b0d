// Behaves, with a bit of everything: what the others differ from.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour&)
{
}
