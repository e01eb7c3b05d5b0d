// A unit's functions under their selectors.

#include "Unit.h"

#include <algorithm>

namespace zebunits
{

namespace
{

struct Instance
{
    AudioComponentPlugInInterface interface; // first: the host's pointer to it is a pointer to all
    std::unique_ptr<Unit> unit;
};

Unit& Of(void* self)
{
    return *static_cast<Instance*>(self)->unit;
}

OSStatus Open(void* /*self*/, AudioComponentInstance /*instance*/)
{
    return noErr;
}

OSStatus Close(void* self)
{
    const std::unique_ptr<Instance> owner(static_cast<Instance*>(self));
    return noErr;
}

OSStatus Initialize(void* self)
{
    return Of(self).Initialize();
}

OSStatus Uninitialize(void* self)
{
    return Of(self).Uninitialize();
}

OSStatus GetPropertyInfo(void* self, AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                         UInt32* size, Boolean* isWritable)
{
    return Of(self).GetPropertyInfo(property, scope, element, *size, *isWritable);
}

OSStatus GetProperty(void* self, AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                     void* data, UInt32* size)
{
    UInt32 needed = 0;
    Boolean isWritable = 0;
    const OSStatus result = Of(self).GetPropertyInfo(property, scope, element, needed, isWritable);
    if (result != noErr)
        return result;
    if (*size < needed)
        return kAudio_ParamError;
    *size = needed;
    return Of(self).GetProperty(property, scope, element, data);
}

OSStatus SetProperty(void* self, AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                     const void* data, UInt32 size)
{
    return Of(self).SetProperty(property, scope, element, data, size);
}

OSStatus GetParameter(void* self, AudioUnitParameterID id, AudioUnitScope scope, AudioUnitElement /*element*/,
                      AudioUnitParameterValue* value)
{
    return Of(self).GetParameter(id, scope, *value);
}

OSStatus SetParameter(void* self, AudioUnitParameterID id, AudioUnitScope scope, AudioUnitElement /*element*/,
                      AudioUnitParameterValue value, UInt32 /*bufferOffset*/)
{
    return Of(self).SetParameter(id, scope, value);
}

OSStatus Reset(void* self, AudioUnitScope /*scope*/, AudioUnitElement /*element*/)
{
    return Of(self).Reset();
}

OSStatus Render(void* self, AudioUnitRenderActionFlags* flags, const AudioTimeStamp* time, UInt32 bus, UInt32 frames,
                AudioBufferList* data)
{
    return Of(self).Render(*flags, *time, bus, frames, *data);
}

template <typename Function>
AudioComponentMethod AsMethod(Function* function)
{
    return reinterpret_cast<AudioComponentMethod>(function);
}

AudioComponentMethod Lookup(SInt16 selector)
{
    switch (selector)
    {
    case kAudioUnitInitializeSelect:
        return AsMethod(Initialize);
    case kAudioUnitUninitializeSelect:
        return AsMethod(Uninitialize);
    case kAudioUnitGetPropertyInfoSelect:
        return AsMethod(GetPropertyInfo);
    case kAudioUnitGetPropertySelect:
        return AsMethod(GetProperty);
    case kAudioUnitSetPropertySelect:
        return AsMethod(SetProperty);
    case kAudioUnitGetParameterSelect:
        return AsMethod(GetParameter);
    case kAudioUnitSetParameterSelect:
        return AsMethod(SetParameter);
    case kAudioUnitResetSelect:
        return AsMethod(Reset);
    case kAudioUnitRenderSelect:
        return AsMethod(Render);
    default:
        return nullptr;
    }
}

} // namespace

AudioComponentPlugInInterface* MakeInterface(std::unique_ptr<Unit> unit)
{
    if (!unit)
        return nullptr;
    return &(new Instance{{Open, Close, Lookup, nullptr}, std::move(unit)})->interface;
}

} // namespace zebunits
