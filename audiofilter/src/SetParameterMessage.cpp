#include "audiofilter/src/SetParameterMessage.h"

#include <utility>

namespace zebaudiofilterhost
{

SetParameterMessage::SetParameterMessage(boost::intrusive_ptr<AudioFilter> filter, int index, float value)
    : mFilter(std::move(filter)), mIndex(index), mValue(value)
{
}

SetParameterMessage::~SetParameterMessage() = default;

bool SetParameterMessage::ExecuteOnProcessThread()
{
    mFilter->SetParameter(mIndex, mValue);
    return true;
}

} // namespace zebaudiofilterhost
