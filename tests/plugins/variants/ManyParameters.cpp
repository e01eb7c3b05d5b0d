// Three thousand parameters.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.parameters.clear();
    for (ParamID id = 0; id < 3000; ++id)
        behaviour.parameters.push_back({.id = 100000 - id,
                                        .title = u"One of many",
                                        .units = u"",
                                        .minimum = 0.0,
                                        .maximum = 1.0,
                                        .initial = 0.5});
}
