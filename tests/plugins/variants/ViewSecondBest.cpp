// A view that knows macOS's old type only.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.viewTypes = {kPlatformTypeHIView};
}
