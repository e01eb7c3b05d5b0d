// Parameters of the unit, and what it tells of them.

#include "host/src/XAU/src/CallGuarded.h"
#include "host/src/XAU/src/XAUAudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost::xau
{

namespace
{

// A list beyond this is a lie of the unit's.
constexpr UInt32 kMaxParameters = 32768;
constexpr std::size_t kMinRoom = 1024; // parameters

constexpr float kListenerSeconds = 0.05F; // between two notifications, and between two values of one parameter

} // namespace

void XAUAudioFilter::BuildParameterInfos()
{
    mParameterByIndex.clear();
    mIndexByParameterID.clear();
    std::vector<AudioUnitParameterID> room(kMinRoom);
    int index = 0;
    for (AudioUnitScope scope = kAudioUnitScope_Global; scope <= kAudioUnitScope_Note; ++scope)
    {
        for (const AudioUnitParameterID id : ReadParameterList(scope, room))
        {
            mParameterInfos.emplace_back(new XAUParameterInfo(mInstance, scope, id));
            mParameterByIndex.emplace(index, mParameterInfos.back());
            mIndexByParameterID.emplace(id, index); // of two scopes with one ID the first
            ++index;
        }
    }
}

// The size is that of the scope, the list that of the global scope, whichever scope is asked for. Units list their
// parameters there, and one that has more of its own in another scope shows the global ones once more: deliberate,
// since indices of saved automation depend on it.
//
// The room is that of the longest list so far: there are units that announce nothing for a scope, and then write all
// that the global scope has.
std::vector<AudioUnitParameterID> XAUAudioFilter::ReadParameterList(AudioUnitScope scope,
                                                                    std::vector<AudioUnitParameterID>& room) const
{
    UInt32 size = 0;
    OSStatus result =
        CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_ParameterList, scope, 0, nullptr, &size);
    DumpResultIfFailed(result, "XAUAudioFilter::BuildParameterInfos(), AudioUnitGetProperty() 1");
    if (result != noErr)
        return {};
    const std::size_t count = std::min<std::size_t>(size / sizeof(AudioUnitParameterID), kMaxParameters);
    const auto announced = static_cast<UInt32>(count * sizeof(AudioUnitParameterID));
    room.assign(std::max(count, room.size()), 0);
    size = announced;
    result = CallGuarded<AudioUnitGetProperty>(mInstance, kAudioUnitProperty_ParameterList, kAudioUnitScope_Global, 0,
                                               room.data(), &size);
    DumpResultIfFailed(result, "XAUAudioFilter::BuildParameterInfos(), AudioUnitGetProperty() 2");
    const std::size_t read = result == noErr ? std::min(size, announced) / sizeof(AudioUnitParameterID) : 0;
    return {room.begin(), room.begin() + static_cast<std::ptrdiff_t>(read)};
}

int XAUAudioFilter::GetParameterCount() const
{
    return static_cast<int>(mParameterInfos.size());
}

XAUParameterInfo* XAUAudioFilter::FindParameter(int index) const
{
    const auto found = mParameterByIndex.find(index);
    return found == mParameterByIndex.end() ? nullptr : found->second.get();
}

void XAUAudioFilter::NotifyListeners(AudioUnitParameterID parameter, AudioUnitScope scope) const
{
    const AudioUnitParameter changed = {mInstance, parameter, scope, 0};
    const OSStatus result = CallGuarded<AUParameterListenerNotify>(nullptr, nullptr, &changed);
    DumpRealtimeResultIfFailed(result, "AUParameterListenerNotify()");
}

void XAUAudioFilter::SetParameter(int index, float value)
{
    if (const XAUParameterInfo* info = FindParameter(index))
    {
        const OSStatus result = CallGuarded<AudioUnitSetParameter>(
            mInstance, info->GetParameterID(), info->GetScope(), 0, info->FromNormalized(value), 0);
        DumpRealtimeResultIfFailed(result, "AudioUnitSetParameter()");
        NotifyListeners(info->GetParameterID(), info->GetScope()); // an open view follows
    }
    AudioFilter::SetParameter(index, value);
}

float XAUAudioFilter::GetParameter(int index) const
{
    const XAUParameterInfo* info = FindParameter(index);
    if (!info)
        return 0.0F;
    AudioUnitParameterValue value = 0.0F;
    const OSStatus result =
        CallGuarded<AudioUnitGetParameter>(mInstance, info->GetParameterID(), info->GetScope(), 0, &value);
    DumpResultIfFailed(result, "AudioUnitGetParameter()");
    return info->ToNormalized(value);
}

boost::intrusive_ptr<AudioFilterParameterInfo> XAUAudioFilter::GetParameterInfo(int index) const
{
    return FindParameter(index);
}

UTF16String XAUAudioFilter::GetParameterString(int index) const
{
    const XAUParameterInfo* info = FindParameter(index);
    return info ? info->GetParameterString(GetParameter(index)) : UTF16String();
}

void XAUAudioFilter::ListenToUnit()
{
    if (AUEventListenerCreate(StaticEventListenerProc, nullptr, CFRunLoopGetCurrent(), kCFRunLoopDefaultMode,
                              kListenerSeconds, kListenerSeconds, &mListener) != noErr)
    {
        mListener = nullptr;
        return;
    }
    // Deliberately with parameter 0 alone: gestures of other parameters start no editing.
    Listen(kAudioUnitEvent_BeginParameterChangeGesture, 0,
           "AUEventListenerAddEventType(), kAudioUnitEvent_BeginParameterChangeGesture");
    Listen(kAudioUnitEvent_EndParameterChangeGesture, 0,
           "AUEventListenerAddEventType(), kAudioUnitEvent_EndParameterChangeGesture");
    for (const auto& [id, index] : mIndexByParameterID)
        Listen(kAudioUnitEvent_ParameterValueChange, id,
               "AUEventListenerAddEventType(), kAudioUnitEvent_ParameterValueChange");
}

// To the global scope alone, on purpose.
void XAUAudioFilter::Listen(AudioUnitEventType type, AudioUnitParameterID parameter, const char* call)
{
    AudioUnitEvent event = {};
    event.mEventType = type;
    event.mArgument.mParameter = {mInstance, parameter, kAudioUnitScope_Global, 0};
    DumpResultIfFailed(AUEventListenerAddEventType(mListener, this, &event), call);
}

void XAUAudioFilter::EventListenerProc(void* /*object*/, const AudioUnitEvent* event, UInt64 /*hostTime*/,
                                       AudioUnitParameterValue /*value*/)
{
    if (!event)
        return;
    constexpr int kSomeParameter = -1; // which one a gesture is about is not resolved
    if (event->mEventType == kAudioUnitEvent_BeginParameterChangeGesture)
        BeginEditing(kSomeParameter);
    else if (event->mEventType == kAudioUnitEvent_EndParameterChangeGesture)
        EndEditing(kSomeParameter);
    else if (event->mEventType == kAudioUnitEvent_ParameterValueChange)
    {
        const auto found = mIndexByParameterID.find(event->mArgument.mParameter.mParameterID);
        if (found != mIndexByParameterID.end())
            FireAutomatedParameterChange(found->second, GetParameter(found->second));
    }
}

void XAUAudioFilter::StaticEventListenerProc(void* /*refCon*/, void* object, const AudioUnitEvent* event,
                                             UInt64 hostTime, AudioUnitParameterValue value)
{
    static_cast<XAUAudioFilter*>(object)->EventListenerProc(object, event, hostTime, value);
}

} // namespace zebaudiofilterhost::xau
