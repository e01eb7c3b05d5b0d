// What a filter asks its application while it processes.
#pragma once

#include "audiofilter/Tempo.h"
#include "foundation/zebcore/Export.h"

namespace zebaudiofilterhost
{

namespace utility
{

/// Kind of a time code; the values are the application's own.
enum class TimecodeFormat : int
{
};

} // namespace utility

/// Implemented by the application and given to AudioFilter::SetAudioFilterHost, which keeps a plain pointer: it must
/// outlive every filter that had it. To take it back with null is not enough: a plug-in's own thread may be asking
/// it.
///
/// The operations are called at the head of each block and from inside plug-in callbacks, which VST 2 plug-ins and
/// Audio Units may make on threads of their own: they must be quick and must not lock.
class ZEB_EXPORT IAudioFilterHost
{
public:
    /// Time code of the project. The library never asks. [process]
    virtual bool GetTimeInfo(utility::TimecodeFormat& format, int& first, int& second) const = 0;

    /// True if the record, zeroed by the caller, was filled. [any]
    virtual bool GetTempo(utility::Tempo& tempo) const = 0;

    /// True if the three were set. [any]
    virtual bool GetTransportState(bool& playing, bool& recording, bool& looping) const = 0;

    virtual ~IAudioFilterHost();
};

} // namespace zebaudiofilterhost
