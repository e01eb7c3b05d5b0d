#include "AudioToolbox/AUComponent.h"
#include "host/src/XAU/linux/src/ComponentInstance.h"

namespace
{

// Calls the unit's function for the selector, which has the given type.
template <typename Function, typename... Arguments>
OSStatus Call(AudioUnit unit, SInt16 selector, Arguments... arguments)
{
    if (!unit)
        return kAudio_ParamError;
    const auto function = reinterpret_cast<Function>(unit->mMethods[static_cast<std::size_t>(selector)]);
    return function ? function(unit->mUnit, arguments...) : kAudio_UnimplementedError;
}

} // namespace

OSStatus AudioUnitInitialize(AudioUnit unit)
{
    return Call<AudioUnitInitializeProc>(unit, kAudioUnitInitializeSelect);
}

OSStatus AudioUnitUninitialize(AudioUnit unit)
{
    return Call<AudioUnitUninitializeProc>(unit, kAudioUnitUninitializeSelect);
}

OSStatus AudioUnitGetPropertyInfo(AudioUnit unit, AudioUnitPropertyID property, AudioUnitScope scope,
                                  AudioUnitElement element, UInt32* size, Boolean* isWritable)
{
    UInt32 unwantedSize = 0;
    Boolean unwantedFlag = 0;
    return Call<AudioUnitGetPropertyInfoProc>(unit, kAudioUnitGetPropertyInfoSelect, property, scope, element,
                                              size ? size : &unwantedSize, isWritable ? isWritable : &unwantedFlag);
}

OSStatus AudioUnitGetProperty(AudioUnit unit, AudioUnitPropertyID property, AudioUnitScope scope,
                              AudioUnitElement element, void* data, UInt32* size)
{
    if (!size)
        return kAudio_ParamError;
    if (!data)
        return AudioUnitGetPropertyInfo(unit, property, scope, element, size, nullptr);
    return Call<AudioUnitGetPropertyProc>(unit, kAudioUnitGetPropertySelect, property, scope, element, data, size);
}

OSStatus AudioUnitSetProperty(AudioUnit unit, AudioUnitPropertyID property, AudioUnitScope scope,
                              AudioUnitElement element, const void* data, UInt32 size)
{
    return Call<AudioUnitSetPropertyProc>(unit, kAudioUnitSetPropertySelect, property, scope, element, data, size);
}

OSStatus AudioUnitAddPropertyListener(AudioUnit unit, AudioUnitPropertyID property,
                                      AudioUnitPropertyListenerProc listener, void* refCon)
{
    return Call<AudioUnitAddPropertyListenerProc>(unit, kAudioUnitAddPropertyListenerSelect, property, listener,
                                                  refCon);
}

OSStatus AudioUnitRemovePropertyListenerWithUserData(AudioUnit unit, AudioUnitPropertyID property,
                                                     AudioUnitPropertyListenerProc listener, void* refCon)
{
    return Call<AudioUnitRemovePropertyListenerWithUserDataProc>(
        unit, kAudioUnitRemovePropertyListenerWithUserDataSelect, property, listener, refCon);
}

OSStatus AudioUnitAddRenderNotify(AudioUnit unit, AURenderCallback callback, void* refCon)
{
    return Call<AudioUnitAddRenderNotifyProc>(unit, kAudioUnitAddRenderNotifySelect, callback, refCon);
}

OSStatus AudioUnitRemoveRenderNotify(AudioUnit unit, AURenderCallback callback, void* refCon)
{
    return Call<AudioUnitRemoveRenderNotifyProc>(unit, kAudioUnitRemoveRenderNotifySelect, callback, refCon);
}

OSStatus AudioUnitGetParameter(AudioUnit unit, AudioUnitParameterID parameter, AudioUnitScope scope,
                               AudioUnitElement element, AudioUnitParameterValue* value)
{
    if (!value)
        return kAudio_ParamError;
    return Call<AudioUnitGetParameterProc>(unit, kAudioUnitGetParameterSelect, parameter, scope, element, value);
}

OSStatus AudioUnitSetParameter(AudioUnit unit, AudioUnitParameterID parameter, AudioUnitScope scope,
                               AudioUnitElement element, AudioUnitParameterValue value, UInt32 bufferOffset)
{
    return Call<AudioUnitSetParameterProc>(unit, kAudioUnitSetParameterSelect, parameter, scope, element, value,
                                           bufferOffset);
}

OSStatus AudioUnitReset(AudioUnit unit, AudioUnitScope scope, AudioUnitElement element)
{
    return Call<AudioUnitResetProc>(unit, kAudioUnitResetSelect, scope, element);
}

OSStatus AudioUnitRender(AudioUnit unit, AudioUnitRenderActionFlags* flags, const AudioTimeStamp* time, UInt32 bus,
                         UInt32 frames, AudioBufferList* data)
{
    if (!time || !data)
        return kAudio_ParamError;
    AudioUnitRenderActionFlags unwantedFlags = 0;
    return Call<AudioUnitRenderProc>(unit, kAudioUnitRenderSelect, flags ? flags : &unwantedFlags, time, bus, frames,
                                     data);
}
