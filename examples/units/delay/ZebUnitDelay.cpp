// A delay of up to a second, mixed with the undelayed sound, behind a look-ahead that it reports as latency. Its
// class info has values of several types beside those of the parameters.

#include "Unit.h"

#include <algorithm>
#include <cmath>

namespace
{

constexpr AudioUnitParameterID kTime = 10;
constexpr AudioUnitParameterID kMix = 11;
constexpr AudioUnitParameterID kMode = 12; // of the echoes: straight, or crossed to the next channel

constexpr Float64 kLookAhead = 0.002; // seconds
constexpr float kPercent = 100.0F;

class DelayUnit : public zebunits::Unit
{
public:
    explicit DelayUnit(const AudioComponentDescription& component)
        : Unit({.component = component,
                .parameters = {{kTime, "Time", kAudioUnitParameterUnit_Seconds, 0.0F, 1.0F, 0.25F},
                               {kMix, "Mix", kAudioUnitParameterUnit_Percent, 0.0F, kPercent, 35.0F},
                               {kMode, "Mode", kAudioUnitParameterUnit_Indexed, 0.0F, 1.0F, 0.0F}}})
    {
    }

    OSStatus Initialize() override
    {
        const OSStatus result = Unit::Initialize();
        if (result == noErr)
            Reset();
        return result;
    }

    OSStatus Reset() override
    {
        const auto length = static_cast<std::size_t>(std::lround(GetSampleRate() * (1.0 + kLookAhead))) + 1;
        mLines.assign(GetOutputChannels(), std::vector<float>(length));
        mPosition = 0;
        return noErr;
    }

protected:
    Float64 GetLatency() const override { return kLookAhead; }

    void Process(const std::vector<Channels>& inputs, const Channels& outputs, UInt32 frames) override
    {
        const std::size_t length = mLines.front().size();
        const auto ahead = static_cast<std::size_t>(std::lround(kLookAhead * GetSampleRate()));
        const auto time =
            static_cast<std::size_t>(std::lround(static_cast<Float64>(GetValue(kTime)) * GetSampleRate()));
        const float mix = GetValue(kMix) / kPercent;
        const std::size_t shift = GetValue(kMode) >= 0.5F ? 1 : 0;
        for (UInt32 frame = 0; frame < frames; ++frame)
        {
            for (std::size_t channel = 0; channel < outputs.size(); ++channel)
                mLines[channel][mPosition] = inputs[0][channel][frame];
            const std::size_t plain = (mPosition + length - ahead) % length;
            const std::size_t echo = (mPosition + length - std::min(ahead + time, length - 1)) % length;
            for (std::size_t channel = 0; channel < outputs.size(); ++channel)
                outputs[channel][frame] =
                    mLines[channel][plain] * (1.0F - mix) + mLines[(channel + shift) % outputs.size()][echo] * mix;
            mPosition = (mPosition + 1) % length;
        }
    }

    void SaveState(CFMutableDictionaryRef state) const override
    {
        static constexpr UInt8 kBytes[] = {0, 1, 2, 0xFF};
        CFDataRef data = CFDataCreate(nullptr, kBytes, sizeof(kBytes));
        CFDictionarySetValue(state, CFSTR("signature"), data);
        CFRelease(data);
        CFDictionarySetValue(state, CFSTR("crossed"), GetValue(kMode) >= 0.5F ? kCFBooleanTrue : kCFBooleanFalse);
        CFStringRef names[] = {CFSTR("straight"), CFSTR("crossed")};
        CFArrayRef modes = CFArrayCreate(nullptr, reinterpret_cast<const void**>(names), 2, &kCFTypeArrayCallBacks);
        CFDictionarySetValue(state, CFSTR("modes"), modes);
        CFRelease(modes);
    }

private:
    std::vector<std::vector<float>> mLines;
    std::size_t mPosition = 0;
};

} // namespace

CF_EXPORT AudioComponentPlugInInterface* ZebUnitDelayFactory(const AudioComponentDescription* description)
{
    return zebunits::MakeInterface(std::make_unique<DelayUnit>(*description));
}
