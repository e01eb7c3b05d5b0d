// getBusInfo fails for all buses, getBusArrangement does not.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kBusInfoResult] = kInternalError;
}
