// Exports "main_macho" and no other entry point.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour&)
{
}
