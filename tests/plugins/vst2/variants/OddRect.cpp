// An editor whose right side lies left of its left one.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kRectLeft] = 300;
    behaviour[Knob::kRectRight] = 100;
    behaviour[Knob::kRectTop] = 20;
    behaviour[Knob::kRectBottom] = -30;
}
