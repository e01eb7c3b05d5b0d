// A view that knows none of the platform's types.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.viewTypes = {kPlatformTypeHWND};
}
