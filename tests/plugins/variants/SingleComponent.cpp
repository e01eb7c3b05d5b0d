// Component and controller are one object.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.classes = {{ClassKind::kSingleComponent}};
}
