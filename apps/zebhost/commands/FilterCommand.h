#pragma once

#include "commands/CommandContext.h"
#include "filter/CrashGuard.h"
#include "filter/LoadFilter.h"
#include "filter/ThrowGuard.h"

namespace zebhost
{

// The filter that the FILTER operand of a command means, loaded. While one lives, a crash or an exception is taken
// for that of its plug-in.
class FilterOfCommand
{
public:
    explicit FilterOfCommand(const CommandContext& context, unsigned int settleMs = kDefaultSettleMs);

    zebaudiofilterhost::AudioFilter& operator*() const { return *mFilter; }
    zebaudiofilterhost::AudioFilter* operator->() const { return mFilter.get(); }
    const zebaudiofilterhost::AudioFilterDescriptor& Descriptor() const { return *mDescriptor; }
    // For people.
    std::string Name() const;

private:
    Catalogue::Descriptor mDescriptor;
    std::string mAdvice;
    CrashGuard mCrashGuard;
    ThrowGuard mThrowGuard;
    FilterPointer mFilter;
};

} // namespace zebhost
