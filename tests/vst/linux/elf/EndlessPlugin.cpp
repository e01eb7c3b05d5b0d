// A shell that never comes to its last member, and takes no time to say so.
#include "host/src/VST/interface/VST2Interface.h"

namespace
{

using namespace zebaudiofilterhost::vst;

long long Answer(AEffect* effect, std::int32_t opcode, std::int32_t, long long, void*, float)
{
    switch (opcode)
    {
    case effGetVstVersion:
        return 2400;
    case effGetPlugCategory:
        return kPlugCategShell;
    case effShellGetNextPlugin:
        return ++effect->uniqueID;
    default:
        return 0;
    }
}

} // namespace

extern "C" __attribute__((visibility("default"))) AEffect* VSTPluginMain(audioMasterCallback)
{
    static AEffect sEffect = {};
    sEffect.magic = kEffectMagic;
    sEffect.dispatcher = Answer;
    return &sEffect;
}
