// A factory with a controller class and no audio class.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.classes = {{ClassKind::kControllerOnly}};
}
