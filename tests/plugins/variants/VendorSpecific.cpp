// Has the vendor-specific interfaces, and a display name that comes from them.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.hiddenInterfaces.clear();
    behaviour.displayName = "Sch\xc3\xb6ner Name";
}
