// Takes a stereo arrangement for five channels of no known shape.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour[Knob::kArrangementType] = kSpeakerArrUserDefined;
    behaviour[Knob::kArrangementChannelsIn] = 5;
    behaviour[Knob::kArrangementChannelsOut] = 5;
    behaviour[Knob::kFollowArrangements] = 0;
}
