#pragma once

#include <AudioToolbox/AudioToolbox.h>

namespace zebaudiofilterhost::xau
{

template <auto Function>
struct GuardedFunction;

template <typename... Arguments, OSStatus (*Function)(Arguments...)>
struct GuardedFunction<Function>
{
    OSStatus operator()(Arguments... arguments) const noexcept
    {
        try
        {
            return Function(arguments...);
        }
        catch (...)
        {
            return kAudioUnitErr_CannotDoInCurrentContext;
        }
    }
};

/// A published function that calls a unit, with that function's arguments. What the unit throws counts as an error
/// code, and goes no further. Filters and views call their unit by this alone. [any]
template <auto Function>
inline constexpr GuardedFunction<Function> CallGuarded = {};

} // namespace zebaudiofilterhost::xau
