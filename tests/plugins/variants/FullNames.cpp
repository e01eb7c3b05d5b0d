// Names that fill all 64 units, with lone surrogates, control characters and no terminator.
#include "tests/plugins/support/Behaviour.h"

void fixture::Vary(Behaviour& behaviour)
{
    std::u16string name = u"Full\u0001\u001b\t\ufffe";
    name += static_cast<char16_t>(0xd800); // a lead without a trail
    name += u"mid";
    name += static_cast<char16_t>(0xdc01); // a trail without a lead
    name.resize(63, u'x');
    name += static_cast<char16_t>(0xdbff); // cut in the middle of a pair
    behaviour.classes = {{ClassKind::kEffect, name, "Fx|Surround"}};
    behaviour.classVendor = std::u16string(64, u'V');
}
