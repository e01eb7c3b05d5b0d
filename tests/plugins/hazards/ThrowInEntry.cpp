// Throws in its entry point.
#include "tests/plugins/support/Behaviour.h"

#include <stdexcept>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atEntry = []
    {
        throw std::runtime_error("thrown by an entry point");
    };
}
