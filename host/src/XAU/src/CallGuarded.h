#pragma once

#include <AudioToolbox/AudioToolbox.h>

namespace zebaudiofilterhost::xau
{

/// Calls a unit. What it throws counts as an error code, and goes no further. [any]
template <typename Call>
OSStatus CallGuarded(const Call& call)
{
    try
    {
        return call();
    }
    catch (...)
    {
        return kAudioUnitErr_CannotDoInCurrentContext;
    }
}

} // namespace zebaudiofilterhost::xau
