// Two effects, each with its controller.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.classes = {{ClassKind::kEffect, u"First", "Fx|EQ"}, {ClassKind::kEffect, u"Second", "Fx|Filter"}};
}
