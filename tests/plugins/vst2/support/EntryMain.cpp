#include "tests/plugins/vst2/support/MakeInstance.h"

extern "C" __attribute__((visibility("default"))) zebaudiofilterhost::vst::AEffect*
VSTPluginMain(zebaudiofilterhost::vst::audioMasterCallback host)
{
    return vst2fixture::MakeInstance("VSTPluginMain", host);
}
