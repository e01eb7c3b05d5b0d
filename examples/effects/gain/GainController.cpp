#include "examples/effects/gain/GainController.h"

namespace effects::gain
{

tresult PLUGIN_API GainController::notify(IMessage* message)
{
    int64 channels = 0;
    if (!IsCalled(message, kFormatMessage) ||
        message->getAttributes()->getInt(kChannelsAttribute, channels) != kResultOk)
        return kResultFalse;
    const Parameter* parameter = mParameters.Find(kChannels);
    return setParamNormalized(kChannels, parameter->ToNormalized(static_cast<double>(channels)));
}

} // namespace effects::gain
