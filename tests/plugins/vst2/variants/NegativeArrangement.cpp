// Says that the arrangement it took has less than no channels.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementChannelsIn] = -3;
    behaviour[Knob::kArrangementChannelsOut] = -3;
}
