// Takes every arrangement, and keeps its two pins all the same.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kFollowArrangements] = 0;
}
