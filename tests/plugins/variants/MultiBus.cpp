// Two stereo buses each way, the second output saying that its right channel is silent.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.inputs = {{u"In A", SpeakerArr::kStereo}, {u"In B", SpeakerArr::kStereo}};
    behaviour.outputs = {{u"Out A", SpeakerArr::kStereo}, {u"Out B", SpeakerArr::kStereo}};
    behaviour[Knob::kOutputSilence1] = 2;
}
