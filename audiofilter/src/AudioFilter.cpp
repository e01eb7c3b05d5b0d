// Life of a filter: construction, ticks, suspending and resuming, cloning.
#include "audiofilter/AudioFilter.h"

#include "audiofilter/src/BusLayouts.h"
#include "module/ModuleUITimer.h"
#include "utility/EffectUtils.h"
#include "utility/ThreadUtils.h"

namespace zebaudiofilterhost
{

AudioFilter::AudioFilter(const UTF16String& id, const UTF16String& displayName)
    : mFilterID(id), mDisplayName(displayName)
{
    mMainTargetBus.SetType(AudioFilterBusDescription::kBusType_Main);
    mSideChainTargetBus.SetType(AudioFilterBusDescription::kBusType_SideChain);
    if (CurrentThreadIDIsMainThreadID())
        mUITimerConnection = ModuleUITimer::GetInstance().ConnectTick([this] { TickWhileHeld(); });
}

AudioFilter::~AudioFilter() = default;

void AudioFilter::TickWhileHeld()
{
    // Nobody holds a filter that is being made or destroyed. Plug-ins may run the main loop from inside both.
    if (GetRefCount() == 0)
        return;
    // A queued message may hold the last reference, and the tick purges it.
    const boost::intrusive_ptr<AudioFilter> held(this);
    OnUITimerTick();
}

void AudioFilter::OnUITimerTick()
{
    FlushMessageQueue();
}

void AudioFilter::Suspend()
{
    SetProcessing(false);
    mSuspended.store(true, std::memory_order_relaxed);
    mSuspendedStateChangedSignal(true);
}

void AudioFilter::Resume()
{
    FlushMessageQueue();
    SetProcessing(true);
    mSuspended.store(false, std::memory_order_relaxed);
    BuildChannelMaps();
    mSuspendedStateChangedSignal(false);
}

boost::intrusive_ptr<AudioFilter> AudioFilter::Clone() const
{
    boost::intrusive_ptr<AudioFilter> clone = utility::CreateAudioFilter(mFilterID);
    if (!clone)
        return clone;
    RequestBuses(*clone, mInputBuses, mOutputBuses);
    clone->SetSampleRate(mSampleRate);

    PropList settings;
    PresetData preset(settings);
    SaveSettings(preset);
    clone->LoadSettings(preset);

    clone->mPresetNameAndDirtyState = mPresetNameAndDirtyState;
    clone->mInputChannelMap = GetChannelMap(kDirection_Input);
    clone->mOutputChannelMap = GetChannelMap(kDirection_Output);
    clone->mMainTargetBus = mMainTargetBus;
    clone->mSideChainTargetBus = mSideChainTargetBus;
    clone->SetUseChannelMap(GetUseChannelMap());
    return clone;
}

boost::intrusive_ptr<AudioFilter> AudioFilter::Clone(boost::intrusive_ptr<AudioFilter> filter)
{
    // So that queued parameter changes are in the state that gets saved. The filter is held here, since a slot may
    // drop the caller's pointer.
    filter->FlushMessageQueue();
    return filter->Clone();
}

} // namespace zebaudiofilterhost
