// A library with an entry point of its own, which a plug-in may need for another reason.
#include "host/src/VST/interface/VST2Interface.h"

#define ZEB_SHOWN __attribute__((visibility("default")))

extern "C" ZEB_SHOWN zebaudiofilterhost::vst::AEffect* VSTPluginMain(zebaudiofilterhost::vst::audioMasterCallback)
{
    return nullptr;
}

extern "C" ZEB_SHOWN int GetBareID()
{
    return 77;
}
