#include "host/src/VST/src/VSTParameterSetting.h"

namespace zebaudiofilterhost::vst
{

namespace
{

constinit thread_local const VSTParameterSetting* sInnermost = nullptr;

} // namespace

VSTParameterSetting::VSTParameterSetting(const VSTAudioFilter* filter, int index)
    : mFilter(filter), mIndex(index), mOuter(sInnermost)
{
    sInnermost = this;
}

// Runs too when the plug-in throws: a record that stayed would point into a stack that has gone.
VSTParameterSetting::~VSTParameterSetting()
{
    sInnermost = mOuter;
}

bool VSTParameterSetting::IsUnderWay(const VSTAudioFilter* filter, int index)
{
    for (const VSTParameterSetting* each = sInnermost; each != nullptr; each = each->mOuter)
    {
        if (each->mFilter == filter && each->mIndex == index)
            return true;
    }
    return false;
}

} // namespace zebaudiofilterhost::vst
