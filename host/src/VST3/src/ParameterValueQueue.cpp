#include "host/src/VST3/src/ParameterValueQueue.h"

#include <algorithm>
#include <cstddef>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::tresult;
using Steinberg::uint32;

ParameterValueQueue::ParameterValueQueue(Steinberg::Vst::ParamID id) : mParameterID(id)
{
    mValues.reserve(kMaxPointsPerParameter);
}

tresult PLUGIN_API ParameterValueQueue::queryInterface(const Steinberg::TUID interfaceID, void** object)
{
    return QueryHostObject<Steinberg::Vst::IParamValueQueue>(*this, interfaceID, object);
}

uint32 PLUGIN_API ParameterValueQueue::addRef()
{
    return mReferenceCount.Add();
}

uint32 PLUGIN_API ParameterValueQueue::release()
{
    const uint32 count = mReferenceCount.Remove();
    if (count == 0)
        delete this;
    return count;
}

Steinberg::Vst::ParamID PLUGIN_API ParameterValueQueue::getParameterId()
{
    return mParameterID;
}

int32 PLUGIN_API ParameterValueQueue::getPointCount()
{
    return static_cast<int32>(mValues.size());
}

tresult PLUGIN_API ParameterValueQueue::getPoint(int32 index, int32& sampleOffset, Steinberg::Vst::ParamValue& value)
{
    if (index < 0 || index >= getPointCount())
        return Steinberg::kResultFalse;
    const ParameterQueueValue& point = mValues[static_cast<std::size_t>(index)];
    sampleOffset = point.mSampleOffset;
    value = point.mValue;
    return Steinberg::kResultOk;
}

tresult PLUGIN_API ParameterValueQueue::addPoint(int32 sampleOffset, Steinberg::Vst::ParamValue value, int32& index)
{
    auto place = std::find_if(mValues.begin(), mValues.end(),
                              [&](const ParameterQueueValue& point) { return point.mSampleOffset >= sampleOffset; });
    if (place != mValues.end() && place->mSampleOffset == sampleOffset)
        place->mValue = value;
    else
        place = mValues.insert(place, {value, sampleOffset});
    index = static_cast<int32>(place - mValues.begin());
    return Steinberg::kResultOk;
}

} // namespace zebaudiofilterhost::vst3
