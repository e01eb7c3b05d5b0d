#include "benchmarks/process/DirectChanges.h"

namespace zebaudiofilterhost::benchmarks
{

using Steinberg::int32;
using Steinberg::kResultFalse;
using Steinberg::kResultOk;
using Steinberg::tresult;

namespace
{

// The effect of the bundle asks these objects for no other face of theirs.
tresult AnswerNothing(void** object)
{
    *object = nullptr;
    return Steinberg::kNoInterface;
}

} // namespace

void DirectChanges::Add(Steinberg::Vst::ParamID id, double value)
{
    const auto index = static_cast<std::size_t>(mCount);
    if (index == mPoints.size())
        return;
    mPoints[index].mID = id;
    mPoints[index].mValue = value;
    ++mCount;
}

tresult PLUGIN_API DirectChanges::queryInterface(const Steinberg::TUID, void** object)
{
    return AnswerNothing(object);
}

Steinberg::Vst::IParamValueQueue* PLUGIN_API DirectChanges::getParameterData(int32 index)
{
    return index >= 0 && index < mCount ? &mPoints[static_cast<std::size_t>(index)] : nullptr;
}

tresult PLUGIN_API DirectChanges::performEdit(Steinberg::Vst::ParamID id, Steinberg::Vst::ParamValue value)
{
    Add(id, value);
    return kResultOk;
}

tresult PLUGIN_API DirectChanges::Point::queryInterface(const Steinberg::TUID, void** object)
{
    return AnswerNothing(object);
}

tresult PLUGIN_API DirectChanges::Point::getPoint(int32 index, int32& offset, Steinberg::Vst::ParamValue& value)
{
    if (index != 0)
        return kResultFalse;
    offset = 0;
    value = mValue;
    return kResultOk;
}

} // namespace zebaudiofilterhost::benchmarks
