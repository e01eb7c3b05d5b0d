// A shell that never comes to its last member, and takes no time to say so: each is a new one, or it begins again.
#include "host/src/VST/interface/VST2Interface.h"

#include <limits>

namespace
{

using namespace zebaudiofilterhost::vst;

#ifdef ZEB_ROUND
constexpr int kRound = ZEB_ROUND;
#else
constexpr int kRound = std::numeric_limits<std::int32_t>::max();
#endif

long long Answer(AEffect* effect, std::int32_t opcode, std::int32_t, long long, void*, float)
{
    switch (opcode)
    {
    case effGetVstVersion:
        return 2400;
    case effGetPlugCategory:
        return kPlugCategShell;
    case effShellGetNextPlugin:
        effect->uniqueID = effect->uniqueID % kRound + 1;
        return effect->uniqueID;
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
    sEffect.uniqueID = 0;
    return &sEffect;
}
