// What the plug-in tells its host about edits and changes of its own, on any thread and while audio runs.

#include "host/src/VST3/src/VST3AudioFilter.h"
#include "utility/ThreadUtils.h"

namespace zebaudiofilterhost::vst3
{

using Steinberg::kResultFalse;
using Steinberg::kResultOk;
using Steinberg::tresult;
using Steinberg::Vst::ParamID;

tresult PLUGIN_API VST3AudioFilter::beginEdit(ParamID id)
{
    const int index = FindParameterIndex(id);
    if (index >= 0)
        BeginEditing(index);
    return kResultOk;
}

// The controller is not called back: it is the source. Parameters that the application does not see reach the
// processor, too.
tresult PLUGIN_API VST3AudioFilter::performEdit(ParamID id, Steinberg::Vst::ParamValue value)
{
    const int index = CanAutomationBeHeard() ? FindParameterIndex(id) : -1;
    if (index >= 0)
        FireAutomatedParameterChange(index, static_cast<float>(value));
    mInputTransfer.AddChange(id, value, 0);
    return kResultOk;
}

tresult PLUGIN_API VST3AudioFilter::endEdit(ParamID id)
{
    const int index = FindParameterIndex(id);
    if (index >= 0)
        EndEditing(index);
    return kResultOk;
}

// A plug-in that is not up yet, or goes, is answered as always, and is not asked.
tresult PLUGIN_API VST3AudioFilter::restartComponent(Steinberg::int32 flags)
{
    using namespace Steinberg::Vst;
    const bool parameters = (flags & (kParamValuesChanged | kParamTitlesChanged)) != 0;
    const bool latency = (flags & kLatencyChanged) != 0;
    const CallGate::Call call(mRestarts);
    if (parameters && call)
    {
        BuildParameterInfos();
        if (CurrentThreadIDIsMainThreadID())
            mParameters.FreeRetired();
        GetParameterPropertiesChangedSignal()();
    }
    if (latency && call && mProcessor)
        mLatency = static_cast<int>(mProcessor->getLatencySamples());
    return parameters || latency ? kResultOk : kResultFalse;
}

} // namespace zebaudiofilterhost::vst3
