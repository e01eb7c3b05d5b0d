#include "examples/effects/vst2/support/Effect.h"

extern "C" __attribute__((visibility("default"))) zebaudiofilterhost::vst::AEffect*
VSTPluginMain(zebaudiofilterhost::vst::audioMasterCallback host)
{
    auto effect = effects::vst2::MakeEffect(host);
    return effect != nullptr ? effect.release()->Binary() : nullptr; // the host's until effClose
}
