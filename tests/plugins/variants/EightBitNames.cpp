// Up to IPluginFactory2: names in UTF-8, the class vendor differs from the factory's.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    behaviour.level = FactoryLevel::kSubCategories;
    behaviour.classes = {{ClassKind::kEffect, u"H\u00fcllkurve \u20ac", "Fx|Reverb|Fx|Delay"}};
    behaviour.classVendor = u"Gr\u00fcne Welle";
}
