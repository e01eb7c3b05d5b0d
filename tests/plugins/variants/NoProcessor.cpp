// A component that is no audio processor.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.hiddenInterfaces.push_back(IAudioProcessor::iid);
}
