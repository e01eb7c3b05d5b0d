// Exports its entry point under the name "main" alone, as plug-ins of long ago did.
#include "tests/plugins/vst2/support/Behaviour.h"
#include "tests/plugins/vst2/support/MakeInstance.h"

// A function of this name cannot be written as it is called.
extern "C" __attribute__((visibility("default"))) zebaudiofilterhost::vst::AEffect*
OldMain(zebaudiofilterhost::vst::audioMasterCallback host) __asm__("main");

zebaudiofilterhost::vst::AEffect* OldMain(zebaudiofilterhost::vst::audioMasterCallback host)
{
    return vst2fixture::MakeInstance("main", host);
}

void vst2fixture::Vary(Behaviour&)
{
}
