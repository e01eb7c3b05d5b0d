#include "tests/xau/support/FakeUnit.h"

#include "host/src/XAU/src/XAUComponentID.h"

#include <algorithm>
#include <cstring>
#include <memory>
#include <stdexcept>

namespace zebaudiofilterhost::xau
{

namespace
{

// By subtype: a factory function has nothing else to tell its units apart.
std::map<OSType, FakeUnit*>& Units()
{
    static std::map<OSType, FakeUnit*> sUnits;
    return sUnits;
}

OSType NextSubType()
{
    static OSType sLast = 0x66000000;
    return ++sLast;
}

struct Instance
{
    AudioComponentPlugInInterface interface; // first: the host's pointer to it is a pointer to all
    FakeUnit* unit;
};

FakeUnit& Of(void* self)
{
    return *static_cast<Instance*>(self)->unit;
}

} // namespace

struct FakeUnit::Calls
{
    static OSStatus Open(void* self, AudioComponentInstance instance)
    {
        FakeUnit& unit = Of(self);
        std::unique_ptr<Instance> owner(static_cast<Instance*>(self)); // frees itself when it does not open
        unit.ThrowIfWanted("open");
        if (unit.mOpenResult != noErr)
            return unit.mOpenResult;
        unit.mInstance = instance;
        static_cast<void>(owner.release());
        return noErr;
    }
    static OSStatus Close(void* self)
    {
        FakeUnit& unit = Of(self);
        unit.mCalls.emplace_back("close");
        delete static_cast<Instance*>(self);
        unit.ThrowIfWanted("close");
        return noErr;
    }
    static OSStatus Initialize(void* self)
    {
        Of(self).mCalls.emplace_back("initialize");
        Of(self).ThrowIfWanted("initialize");
        return Of(self).mInitializeResult;
    }
    static OSStatus Uninitialize(void* self)
    {
        Of(self).mCalls.emplace_back("uninitialize");
        Of(self).ThrowIfWanted("uninitialize");
        return noErr;
    }
    static OSStatus GetPropertyInfo(void* self, AudioUnitPropertyID property, AudioUnitScope scope,
                                    AudioUnitElement element, UInt32* size, Boolean* isWritable)
    {
        const FakeUnit& unit = Of(self);
        unit.ThrowIfWanted("get property info");
        const auto found = unit.mProperties.find({property, scope, element});
        if (found == unit.mProperties.end())
            return kAudioUnitErr_InvalidProperty;
        const auto announced = unit.mAnnounced.find(found->first);
        *size = announced == unit.mAnnounced.end() ? static_cast<UInt32>(found->second.size()) : announced->second;
        *isWritable = 1;
        return noErr;
    }
    static OSStatus GetProperty(void* self, AudioUnitPropertyID property, AudioUnitScope scope,
                                AudioUnitElement element, void* data, UInt32* size)
    {
        const FakeUnit& unit = Of(self);
        unit.ThrowIfWanted("get property");
        if (unit.mThrowsOf.count(property) != 0)
            throw std::runtime_error("get property");
        const auto found = unit.mProperties.find({property, scope, element});
        if (found == unit.mProperties.end())
            return kAudioUnitErr_InvalidProperty;
        if (!unit.mIgnoresAnnouncedSize)
            *size = std::min(*size, static_cast<UInt32>(found->second.size()));
        else
            *size = static_cast<UInt32>(found->second.size());
        std::copy_n(found->second.begin(), *size, static_cast<std::byte*>(data));
        return noErr;
    }
    static OSStatus SetProperty(void* self, AudioUnitPropertyID property, AudioUnitScope scope,
                                AudioUnitElement element, const void* data, UInt32 size)
    {
        FakeUnit& unit = Of(self);
        unit.ThrowIfWanted("set property");
        const Key key(property, scope, element);
        unit.mCalls.push_back("set " + std::to_string(property) + " " + std::to_string(scope) + " " +
                              std::to_string(element));
        if (unit.mRefused.count(key) != 0)
            return kAudioUnitErr_FormatNotSupported;
        unit.AnswerBytes(key, {static_cast<const std::byte*>(data), size});
        return noErr;
    }
    static OSStatus GetParameter(void* self, AudioUnitParameterID id, AudioUnitScope scope,
                                 AudioUnitElement /*element*/, AudioUnitParameterValue* value)
    {
        Of(self).ThrowIfWanted("get parameter");
        const auto found = Of(self).mValues.find({scope, id});
        if (found == Of(self).mValues.end())
            return kAudioUnitErr_InvalidParameter;
        *value = found->second;
        return noErr;
    }
    static OSStatus SetParameter(void* self, AudioUnitParameterID id, AudioUnitScope scope,
                                 AudioUnitElement /*element*/, AudioUnitParameterValue value, UInt32 /*offset*/)
    {
        Of(self).ThrowIfWanted("set parameter");
        Of(self).mValues[{scope, id}] = value;
        return noErr;
    }
    static OSStatus Reset(void* self, AudioUnitScope scope, AudioUnitElement element)
    {
        Of(self).mCalls.push_back("reset " + std::to_string(scope) + " " + std::to_string(element));
        Of(self).ThrowIfWanted("reset");
        return noErr;
    }
    static OSStatus Render(void* self, AudioUnitRenderActionFlags* /*flags*/, const AudioTimeStamp* time,
                           UInt32 /*bus*/, UInt32 frames, AudioBufferList* data)
    {
        Of(self).mCalls.push_back("render " + std::to_string(frames));
        Of(self).mTimes.push_back(*time);
        Of(self).ThrowIfWanted("render");
        return Of(self).mRender(frames, *data);
    }
    static AudioComponentMethod Lookup(SInt16 selector)
    {
        const auto method = [](auto* function)
        {
            return reinterpret_cast<AudioComponentMethod>(function);
        };
        static const std::map<SInt16, AudioComponentMethod> sMethods = {
            {kAudioUnitInitializeSelect, method(Initialize)},
            {kAudioUnitUninitializeSelect, method(Uninitialize)},
            {kAudioUnitGetPropertyInfoSelect, method(GetPropertyInfo)},
            {kAudioUnitGetPropertySelect, method(GetProperty)},
            {kAudioUnitSetPropertySelect, method(SetProperty)},
            {kAudioUnitGetParameterSelect, method(GetParameter)},
            {kAudioUnitSetParameterSelect, method(SetParameter)},
            {kAudioUnitResetSelect, method(Reset)},
            {kAudioUnitRenderSelect, method(Render)}};
        const auto found = sMethods.find(selector);
        return found == sMethods.end() ? nullptr : found->second;
    }
};

FakeUnit::FakeUnit(OSType type, const char* name, OSType manufacturer)
    : mDescription{type, NextSubType(), manufacturer, 0, 0}
{
    Units()[mDescription.componentSubType] = this;
    CFStringRef text = CFStringCreateWithCString(nullptr, name, kCFStringEncodingUTF8);
    mComponent = AudioComponentRegister(&mDescription, text, 0x00020001, Create);
    CFRelease(text);
    SetElements(kAudioUnitScope_Input, {2});
    SetElements(kAudioUnitScope_Output, {2});
}

FakeUnit::~FakeUnit()
{
    Units().erase(mDescription.componentSubType);
}

// Components are never forgotten: one whose test is over gives no instance.
AudioComponentPlugInInterface* FakeUnit::Create(const AudioComponentDescription* description)
{
    const auto found = Units().find(description->componentSubType);
    if (found == Units().end() || !found->second->mGivesInstance)
        return nullptr;
    found->second->mCalls.emplace_back("create");
    found->second->ThrowIfWanted("create");
    return &(new Instance{{Calls::Open, Calls::Close, Calls::Lookup, nullptr}, found->second})->interface;
}

void FakeUnit::ThrowIfWanted(const char* call) const
{
    if (mThrowsIn.count(call) != 0)
        throw std::runtime_error(call);
}

UTF16String FakeUnit::GetID() const
{
    return EncodeComponentID(mDescription);
}

boost::intrusive_ptr<XAUAudioFilter> FakeUnit::MakeFilter() const
{
    return XAUAudioFilter::Create(u"4:" + GetID());
}

void FakeUnit::AnswerBytes(const Key& key, std::span<const std::byte> bytes)
{
    mProperties[key].assign(bytes.begin(), bytes.end());
}

void FakeUnit::SetElements(AudioUnitScope scope, const std::vector<UInt32>& channels)
{
    Answer({kAudioUnitProperty_ElementCount, scope, 0}, static_cast<UInt32>(channels.size()));
    for (std::size_t element = 0; element < channels.size(); ++element)
    {
        AudioStreamBasicDescription format = {};
        format.mSampleRate = 1000.0;
        format.mChannelsPerFrame = channels[element];
        Answer(FormatOf(scope, static_cast<AudioUnitElement>(element)), format);
    }
}

UInt32 FakeUnit::GetChannels(AudioUnitScope scope, AudioUnitElement element) const
{
    return Read<AudioStreamBasicDescription>(FormatOf(scope, element)).mChannelsPerFrame;
}

void FakeUnit::SetParameters(const std::vector<AudioUnitParameterID>& ids, Float32 minimum, Float32 maximum)
{
    AnswerList(Global(kAudioUnitProperty_ParameterList), ids);
    for (const AudioUnitParameterID id : ids)
    {
        AudioUnitParameterInfo info = {};
        std::strncpy(info.name, "P", sizeof(info.name) - 1);
        info.minValue = minimum;
        info.maxValue = maximum;
        info.flags = kAudioUnitParameterFlag_IsReadable | kAudioUnitParameterFlag_IsWritable;
        Answer({kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, id}, info);
        mValues[{kAudioUnitScope_Global, id}] = minimum;
    }
}

OSStatus FakeUnit::Pull(UInt32 bus, UInt32 frames, AudioBufferList& data) const
{
    const auto callback =
        Read<AURenderCallbackStruct>({kAudioUnitProperty_SetRenderCallback, kAudioUnitScope_Input, bus});
    AudioUnitRenderActionFlags flags = 0;
    const AudioTimeStamp time = {};
    return callback.inputProc ? callback.inputProc(callback.inputProcRefCon, &flags, &time, bus, frames, &data)
                              : kAudioUnitErr_NoConnection;
}

std::size_t FakeUnit::CountCalls(const std::string& call) const
{
    return static_cast<std::size_t>(std::count(mCalls.begin(), mCalls.end(), call));
}

} // namespace zebaudiofilterhost::xau
