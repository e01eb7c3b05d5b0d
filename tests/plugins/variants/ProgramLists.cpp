// Two program lists, of which the root unit has the second; a child unit comes first.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.units = {{5, 31}, {kRootUnitId, 21}};
    behaviour.programLists = {{31, u"Child ", 3}, {21, u"Root ", 5}};
}
