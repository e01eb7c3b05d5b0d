// Exports "VSTPluginMain" and "main_macho".
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour&)
{
}
