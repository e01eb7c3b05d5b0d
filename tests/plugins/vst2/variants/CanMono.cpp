// Stereo pins; refuses arrangements, but says that it can serve one channel.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kCanMono] = 1;
    behaviour[Knob::kAcceptArrangements] = 0;
}
