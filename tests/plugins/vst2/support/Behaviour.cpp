#include "tests/plugins/vst2/support/Behaviour.h"

namespace vst2fixture
{

const Behaviour& TheBehaviour()
{
    static const Behaviour sBehaviour = []
    {
        Behaviour behaviour;
        Vary(behaviour);
        return behaviour;
    }();
    return sBehaviour;
}

} // namespace vst2fixture
