// Texts that are no UTF-8.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    behaviour.name = "Bad \xff\xfe Name";
    behaviour.vendor = "\x80\x81";
    behaviour.parameters = {{"\xc3", "\xf0\x9f"}, {"\xed\xa0\x80", "\xc0\xaf"}, {"tab\tbell\a", "\xb5"}};
    behaviour.programs = {"\xe2\x82", "\xff", "\xc3\xa4\xc3\xb6"};
}
