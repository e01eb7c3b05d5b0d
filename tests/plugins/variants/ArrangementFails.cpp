// getBusArrangement fails for the second of two buses.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.inputs = {{u"In A", SpeakerArr::kStereo}, {u"In B", SpeakerArr::kStereo}};
    behaviour.outputs = {{u"Out A", SpeakerArr::kStereo}, {u"Out B", SpeakerArr::kStereo}};
    behaviour[Knob::kBusArrangementResult] = kInternalError;
    behaviour[Knob::kFailingBus] = 1;
}
