// A unit that writes down what it is asked to do, and keeps an eye on every object that it hands out.

#include "Unit.h"
#include "tests/plugins/support/Recorder.h"
#include "tests/plugins/units/HandedOut.h"
#include "tests/plugins/units/RecorderKnobs.h"

#include <algorithm>
#include <cstring>

namespace
{

using fixture::HandOut;
using fixture::InputMemory;
using fixture::Knobs;
using fixture::Record;

enum : AudioUnitParameterID
{
    kReleased, // its texts are the host's to release
    kKept,     // its texts stay the unit's
    kPlain,    // has an 8-bit name alone
    kIndexed   // has named steps
};

constexpr float kUntouched = 77.0F;

CFStringRef MakeText(const char* text)
{
    return CFStringCreateWithCString(nullptr, text, kCFStringEncodingUTF8);
}

template <typename T>
void Put(void* data, const T& value)
{
    std::memcpy(data, &value, sizeof(value));
}

class RecorderUnit : public zebunits::Unit
{
public:
    explicit RecorderUnit(const AudioComponentDescription& component)
        : Unit({.component = component,
                .parameters = {{kReleased, "Released", kAudioUnitParameterUnit_CustomUnit, 0.0F, 1.0F, 0.5F},
                               {kKept, "Kept", kAudioUnitParameterUnit_CustomUnit, 0.0F, 1.0F, 0.5F},
                               {kPlain, "Plain", kAudioUnitParameterUnit_Generic, 0.0F, 1.0F, 0.5F},
                               {kIndexed, "Indexed", kAudioUnitParameterUnit_Indexed, 0.0F, 1.0F, 0.0F}},
                .presets = {{"First", {{kPlain, 0.25F}}}}})
    {
        Record("Create");
    }
    ~RecorderUnit() override
    {
        Record("Close");
        CFRelease(mKeptName);
        CFRelease(mKeptUnit);
    }

    OSStatus Initialize() override
    {
        Record("Initialize");
        mInput.assign(2 * GetMaxFrames(), 0.0F);
        mOutput.assign(2 * GetMaxFrames(), 0.0F);
        return Unit::Initialize();
    }
    OSStatus Uninitialize() override
    {
        Record("Uninitialize");
        return Unit::Uninitialize();
    }
    OSStatus Reset() override
    {
        Record("Reset");
        return noErr;
    }

    OSStatus GetPropertyInfo(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                             UInt32& size, Boolean& isWritable) override
    {
        if (property == kAudioUnitProperty_ParameterStringFromValue)
            size = sizeof(AudioUnitParameterStringFromValue);
        else if (property == kAudioUnitProperty_ParameterValueStrings && element == kIndexed)
            size = sizeof(CFArrayRef);
        else
            return Unit::GetPropertyInfo(property, scope, element, size, isWritable);
        return noErr;
    }

    OSStatus GetProperty(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                         void* data) override
    {
        switch (property)
        {
        case kAudioUnitProperty_ParameterInfo:
            FillInfo(element, *static_cast<AudioUnitParameterInfo*>(data));
            return noErr;
        case kAudioUnitProperty_ParameterStringFromValue:
            static_cast<AudioUnitParameterStringFromValue*>(data)->outString =
                static_cast<CFStringRef>(HandOut("value text", MakeText("some")));
            return noErr;
        case kAudioUnitProperty_ParameterValueStrings:
            Put(data, HandOut("step names", MakeStepNames()));
            return noErr;
        default:
            break;
        }
        const OSStatus result = Unit::GetProperty(property, scope, element, data);
        if (result == noErr)
            NoteObject(property, data);
        if (property == kAudioUnitProperty_StreamFormat && Knobs().refusesFormats != 0)
            Interleave(*static_cast<AudioStreamBasicDescription*>(data));
        return result;
    }

    OSStatus SetProperty(AudioUnitPropertyID property, AudioUnitScope scope, AudioUnitElement element,
                         const void* data, UInt32 size) override
    {
        Record("Set", property, scope, element);
        if (property == kAudioUnitProperty_StreamFormat && Knobs().refusesFormats != 0)
            return kAudioUnitErr_FormatNotSupported;
        if (property == kAudioUnitProperty_SetRenderCallback && size == sizeof(mCallback))
            std::memcpy(&mCallback, data, sizeof(mCallback));
        if (property == kAudioUnitProperty_ClassInfo)
            HandOut("given class info", *static_cast<const CFPropertyListRef*>(data));
        return Unit::SetProperty(property, scope, element, data, size);
    }

    OSStatus Render(AudioUnitRenderActionFlags& /*flags*/, const AudioTimeStamp& time, UInt32 /*bus*/, UInt32 frames,
                    AudioBufferList& data) override
    {
        Record("Render", frames);
        if (Knobs().renderResult != 0)
            return static_cast<OSStatus>(Knobs().renderResult);
        if (frames > GetMaxFrames())
            return kAudioUnitErr_TooManyFramesToProcess;
        const auto memory = static_cast<InputMemory>(static_cast<int>(Knobs().inputMemory));
        struct
        {
            AudioBufferList list;
            AudioBuffer second;
        } pulled = {};
        AudioBuffer* const buffers = std::data(pulled.list.mBuffers);
        const UInt32 count = memory == InputMemory::Interleaved ? 1 : 2;
        const UInt32 perBuffer = frames * 2 / count;
        std::fill(mInput.begin(), mInput.end(), kUntouched);
        pulled.list.mNumberBuffers = count;
        for (UInt32 index = 0; index < count; ++index)
            buffers[index] = {2 / count, perBuffer * static_cast<UInt32>(sizeof(float)),
                              memory == InputMemory::Null ? nullptr : mInput.data() + index * perBuffer};
        AudioUnitRenderActionFlags flags = 0;
        if (mCallback.inputProc)
            mCallback.inputProc(mCallback.inputProcRefCon, &flags, &time, 0, frames, &pulled.list);
        Record("Pulled", buffers[0].mNumberChannels, buffers[0].mDataByteSize);
        for (UInt32 index = 0; index < std::min(count, data.mNumberBuffers); ++index)
        {
            float* const target = mOutput.data() + index * perBuffer;
            std::copy_n(static_cast<const float*>(buffers[index].mData), perBuffer, target);
            data.mBuffers[index] = {1, perBuffer * static_cast<UInt32>(sizeof(float)), target};
        }
        return noErr;
    }

protected:
    void Process(const std::vector<Channels>& /*inputs*/, const Channels& /*outputs*/, UInt32 /*frames*/) override {}

private:
    void FillInfo(AudioUnitParameterID id, AudioUnitParameterInfo& info) const
    {
        info = {};
        std::strncpy(info.name, "Plain", sizeof(info.name) - 1);
        info.minValue = 0.0F;
        info.maxValue = 1.0F;
        info.flags = kAudioUnitParameterFlag_IsReadable | kAudioUnitParameterFlag_IsWritable;
        info.unit = id == kIndexed ? kAudioUnitParameterUnit_Indexed : kAudioUnitParameterUnit_Generic;
        if (id != kReleased && id != kKept)
            return;
        const bool isKept = id == kKept;
        info.unit = kAudioUnitParameterUnit_CustomUnit;
        info.flags |= kAudioUnitParameterFlag_HasCFNameString;
        info.flags |= isKept ? 0U : kAudioUnitParameterFlag_CFNameRelease;
        info.cfNameString = static_cast<CFStringRef>(isKept ? HandOut("kept name", mKeptName)
                                                            : HandOut("name", MakeText("Released")));
        info.unitName = static_cast<CFStringRef>(isKept ? HandOut("kept unit name", mKeptUnit)
                                                        : HandOut("unit name", MakeText("widgets")));
    }

    static CFArrayRef MakeStepNames()
    {
        CFMutableArrayRef names = CFArrayCreateMutable(nullptr, 0, &kCFTypeArrayCallBacks);
        for (const char* name : {"low", "high"})
        {
            CFStringRef text = MakeText(name);
            CFArrayAppendValue(names, text);
            CFRelease(text);
        }
        return names;
    }

    static void NoteObject(AudioUnitPropertyID property, const void* data)
    {
        if (property == kAudioUnitProperty_ClassInfo)
            HandOut("class info", *static_cast<const CFTypeRef*>(data));
        else if (property == kAudioUnitProperty_FactoryPresets)
            HandOut("presets", *static_cast<const CFTypeRef*>(data));
        else if (property == kAudioUnitProperty_ElementName)
            HandOut("element name", *static_cast<const CFTypeRef*>(data));
    }

    static void Interleave(AudioStreamBasicDescription& format)
    {
        format.mFormatFlags &= ~static_cast<UInt32>(kAudioFormatFlagIsNonInterleaved);
        format.mBytesPerFrame = format.mChannelsPerFrame * static_cast<UInt32>(sizeof(float));
        format.mBytesPerPacket = format.mBytesPerFrame;
    }

    CFStringRef mKeptName = MakeText("Kept");
    CFStringRef mKeptUnit = MakeText("gadgets");
    AURenderCallbackStruct mCallback = {};
    std::vector<float> mInput;
    std::vector<float> mOutput;
};

} // namespace

CF_EXPORT AudioComponentPlugInInterface* RecorderUnitFactory(const AudioComponentDescription* description)
{
    return zebunits::MakeInterface(std::make_unique<RecorderUnit>(*description));
}
