// A main and a side-chain input.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.inputs = {{u"In", SpeakerArr::kStereo}, {u"Side-chain", SpeakerArr::kStereo, kAux}};
}
