// A parameter change on its way to the process thread.
#pragma once

#include "audiofilter/AudioFilter.h"

namespace zebaudiofilterhost
{

/// Keeps its filter alive until it has run and been purged.
class SetParameterMessage : public Message
{
public:
    SetParameterMessage(boost::intrusive_ptr<AudioFilter> filter, int index, float value);

    ~SetParameterMessage() override;

    bool ExecuteOnProcessThread() override;

private:
    boost::intrusive_ptr<AudioFilter> mFilter;
    int mIndex;
    float mValue; // Normalised
};

} // namespace zebaudiofilterhost
