// Program lists, and a root unit that has none of them.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.units = {{kRootUnitId, kNoProgramListId}, {5, 21}};
}
