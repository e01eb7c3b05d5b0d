// getParameterInfo fails for every parameter.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kParameterInfoResult] = kInternalError;
}
