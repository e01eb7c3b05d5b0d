// Says that the arrangement it took has no channels.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementChannelsIn] = 0;
    behaviour[Knob::kArrangementChannelsOut] = 0;
}
