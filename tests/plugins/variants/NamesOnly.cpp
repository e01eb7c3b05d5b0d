// Only IPluginFactory: no sub-categories, and no vendor but the factory's.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.level = FactoryLevel::kNamesOnly;
}
