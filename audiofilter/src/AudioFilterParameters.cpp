// Parameters and the gestures on them.
#include "audiofilter/AudioFilter.h"
#include "audiofilter/src/SetParameterMessage.h"
#include "foundation/zebcore/StringStreams.h"

namespace zebaudiofilterhost
{

int AudioFilter::GetParameterCount() const
{
    return 0;
}

void AudioFilter::SetParameterAutomated(int index, float value)
{
    SetParameter(index, value);
    FireAutomatedParameterChange(index, value);
}

void AudioFilter::SetParameter(int, float)
{
    BumpParameterDirtyCount();
}

float AudioFilter::GetParameter(int) const
{
    return 0.0F;
}

boost::intrusive_ptr<AudioFilterParameterInfo> AudioFilter::GetParameterInfo(int) const
{
    return {};
}

UTF16String AudioFilter::GetParameterString(int index) const
{
    zebcore::utility::oUTF16StringStream text;
    text << GetParameter(index);
    return text.str();
}

void AudioFilter::PostSetParameter(int index, float value)
{
    Post(boost::intrusive_ptr<Message>(
        new SetParameterMessage(boost::intrusive_ptr<AudioFilter>(this), index, value)));
}

unsigned int AudioFilter::GetParameterDirtyCount() const
{
    return mParameterDirtyCount.load(std::memory_order_relaxed);
}

void AudioFilter::BumpParameterDirtyCount()
{
    mParameterDirtyCount.fetch_add(1, std::memory_order_relaxed);
}

void AudioFilter::BeginEditing(int index)
{
    mEditingStateSignal(index, true);
}

void AudioFilter::EndEditing(int index)
{
    mEditingStateSignal(index, false);
}

} // namespace zebaudiofilterhost
