// Neither half has a connection point, and there is no unit info.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.hiddenInterfaces.insert(behaviour.hiddenInterfaces.end(), {IConnectionPoint::iid, IUnitInfo::iid});
}
