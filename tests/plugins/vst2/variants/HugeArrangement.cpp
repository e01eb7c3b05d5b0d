// Says that the arrangement it took has a million channels.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementChannelsIn] = 1000000;
    behaviour[Knob::kArrangementChannelsOut] = 1000000;
}
