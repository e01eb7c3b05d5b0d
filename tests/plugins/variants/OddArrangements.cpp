// Nameless buses: mono, 5.1, nothing at all, and only speakers that nobody knows.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.inputs = {{u"", SpeakerArr::kMono}, {u"", SpeakerArr::k51}, {u"Nothing", 0}};
    behaviour.outputs = {{u"", SpeakerArr::k51}, {u"", SpeakerArrangement{7} << 40}, {u"", SpeakerArr::kStereo}};
}
