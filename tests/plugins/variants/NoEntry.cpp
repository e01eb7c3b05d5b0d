// Behaves, but exports neither entry nor exit.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour&)
{
}
