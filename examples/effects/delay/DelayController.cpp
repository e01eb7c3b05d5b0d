#include "examples/effects/delay/DelayController.h"

#include <cmath>

namespace effects::delay
{

tresult PLUGIN_API DelayController::setParamNormalized(ParamID id, ParamValue value)
{
    const double before = mParameters.Plain(id);
    const tresult result = Controller::setParamNormalized(id, value);
    if (id != kLookAhead || mParameters.Plain(id) == before)
        return result;
    const int64 samples = std::llround(mParameters.Plain(id));
    Send(mHost, kLookAheadMessage,
         [=](IAttributeList& attributes) { attributes.setInt(kSamplesAttribute, samples); });
    if (mHandler != nullptr)
        mHandler->restartComponent(kLatencyChanged);
    return result;
}

} // namespace effects::delay
