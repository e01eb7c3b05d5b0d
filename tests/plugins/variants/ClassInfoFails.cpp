// getClassInfo fails for the first of two effects (classes 0 and 2; 1 and 3 are controllers).
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.classes = {{ClassKind::kEffect, u"Unknown"}, {ClassKind::kEffect, u"Known"}};
    behaviour[Knob::kFailingClassInfo] = 0;
}
