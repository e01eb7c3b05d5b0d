// Throws when a component is created.
#include "tests/plugins/support/Behaviour.h"

#include <stdexcept>

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.atCreate = []
    {
        throw std::runtime_error("thrown by createInstance");
    };
}
