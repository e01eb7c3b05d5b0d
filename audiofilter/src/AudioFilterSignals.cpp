// Signals and the ways to connect to them.
#include "audiofilter/AudioFilter.h"

namespace zebaudiofilterhost
{

using boost::signals2::connection;

AudioFilter::AutomatedParameterChangeSignal& AudioFilter::GetAutomatedParameterChangeSignal()
{
    mAutomationCanBeHeard.store(true, std::memory_order_relaxed);
    return mAutomatedParameterChangeSignal;
}

AudioFilter::ParameterPropertiesChangedSignal& AudioFilter::GetParameterPropertiesChangedSignal()
{
    return mParameterPropertiesChangedSignal;
}

AudioFilter::SuspendedStateChangedSignal& AudioFilter::GetSuspendedStateChangedSignal()
{
    return mSuspendedStateChangedSignal;
}

connection AudioFilter::ConnectAutomatedParameterChange(const AutomatedParameterChangeSignal::slot_type& slot)
{
    return GetAutomatedParameterChangeSignal().connect(slot);
}

connection AudioFilter::ConnectParameterPropertiesChanged(const ParameterPropertiesChangedSignal::slot_type& slot)
{
    return mParameterPropertiesChangedSignal.connect(slot);
}

connection AudioFilter::ConnectPresetChanged(const PresetChangedSignal::slot_type& slot)
{
    return mPresetChangedSignal.connect(slot);
}

connection AudioFilter::ConnectEditingStateChange(const EditingStateSignal::slot_type& slot)
{
    return mEditingStateSignal.connect(slot);
}

connection AudioFilter::ConnectChannelMapChanged(const ChannelMapChangedSignal::slot_type& slot)
{
    return mChannelMapChangedSignal.connect(slot);
}

connection AudioFilter::ConnectTargetFormatChanged(const TargetFormatChangedSignal::slot_type& slot)
{
    return mTargetFormatChangedSignal.connect(slot);
}

connection AudioFilter::ConnectSuspendedStateChanged(const SuspendedStateChangedSignal::slot_type& slot)
{
    return mSuspendedStateChangedSignal.connect(slot);
}

} // namespace zebaudiofilterhost
