// A class without a name, so that nothing but the class record is left, which is empty too.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.level = FactoryLevel::kSubCategories;
    behaviour.classes = {{ClassKind::kEffect, u"?"}};
    behaviour.classes.front().name.front() = u'\0';
}
