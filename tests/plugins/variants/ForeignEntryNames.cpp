// Behaves, but exports entry and exit by their names on macOS only.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour&)
{
}
