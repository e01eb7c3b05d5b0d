// Says that it has fewer than no buses, parameters, units, program lists and programs.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    for (const Knob knob : {Knob::kBusCount, Knob::kParameterCount, Knob::kUnitCount, Knob::kProgramListCount,
                            Knob::kProgramCount, Knob::kParameterStepCount})
        behaviour[knob] = -2147483648.0;
}
