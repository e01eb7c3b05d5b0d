// Nothing but an instrument.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.classes = {{ClassKind::kInstrument, {}, "Instrument|Synth"}};
    behaviour.inputs = {{u"Notes", 0, kMain, kEvent}};
}
