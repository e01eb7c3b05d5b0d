// Throws in its entry point.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <stdexcept>

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        throw std::runtime_error("thrown by the entry point");
    };
}
