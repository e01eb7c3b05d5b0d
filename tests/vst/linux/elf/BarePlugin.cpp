// A plug-in of an effect without any function. It exports "main" alone, but the library that it needs has
// VSTPluginMain.
#include "host/src/VST/interface/VST2Interface.h"

extern "C" int GetBareID();

// A function of this name cannot be written as it is called.
extern "C" __attribute__((visibility("default"))) zebaudiofilterhost::vst::AEffect*
BareMain(zebaudiofilterhost::vst::audioMasterCallback host) __asm__("main");

zebaudiofilterhost::vst::AEffect* BareMain(zebaudiofilterhost::vst::audioMasterCallback)
{
    static zebaudiofilterhost::vst::AEffect sEffect = {};
    sEffect.magic = zebaudiofilterhost::vst::kEffectMagic;
    sEffect.uniqueID = GetBareID();
    return &sEffect;
}
