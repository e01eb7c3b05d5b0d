// ZebGain2: a gain for mono, stereo and 5.1, with text both ways.
#include "examples/effects/vst2/support/Effect.h"
#include "examples/effects/vst2/support/Text.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace effects::vst2
{

namespace
{

enum : std::int32_t
{
    kGain,  // dB, its lowest value is silence
    kBypass // switch
};

// 0 dB lies at 0.75 exactly, so that the default gain is 1 to the last bit.
constexpr float kLowest = -72.0F;
constexpr float kRange = 96.0F;

#if defined(ZEB_PLAIN)
constexpr std::int32_t kUniqueID = FourCharacters("ZbGp");
#else
constexpr std::int32_t kUniqueID = FourCharacters("ZbGn");
#endif

class Gain : public Effect
{
public:
    explicit Gain(audioMasterCallback host)
        : Effect(host, {.uniqueID = kUniqueID,
                        .name = "Zeb Gain 2",
                        .category = kPlugCategEffect,
                        .parameters = {{"Gain", "dB", 0.75F}, {"Bypass", "", 0.0F, kVstParameterIsSwitch}}})
    {
    }

protected:
    void Process(const float* const* inputs, float* const* outputs, std::int32_t frames) override;
    std::string Display(std::int32_t index) const override;
    std::optional<float> Read(std::int32_t index, const std::string& text) const override;
    long long Answer(const Call& call) override;

private:
    float Decibels() const { return kLowest + kRange * Get(kGain); }
    float Factor() const;
    long long Arrange(const VstSpeakerArrangement* input, const VstSpeakerArrangement* output);

    std::array<VstSpeakerArrangement, 2> mArrangements{}; // input, output
};

bool IsKnown(const VstSpeakerArrangement& arrangement)
{
    switch (arrangement.type)
    {
    case kSpeakerArrMono:
        return arrangement.numChannels == 1;
    case kSpeakerArrStereo:
        return arrangement.numChannels == 2;
    case kSpeakerArr51:
        return arrangement.numChannels == 6;
    default:
        return false;
    }
}

float Gain::Factor() const
{
    if (Get(kBypass) >= 0.5F)
        return 1.0F;
    return Get(kGain) <= 0.0F ? 0.0F : std::pow(10.0F, Decibels() / 20.0F);
}

void Gain::Process(const float* const* inputs, float* const* outputs, std::int32_t frames)
{
    const float factor = Factor();
    for (std::int32_t channel = 0; channel < Binary()->numOutputs; ++channel)
        std::transform(inputs[channel], inputs[channel] + frames, outputs[channel],
                       [factor](float sample) { return sample * factor; });
}

std::string Gain::Display(std::int32_t index) const
{
    if (index == kBypass)
        return Get(kBypass) >= 0.5F ? "On" : "Off";
    return Get(kGain) <= 0.0F ? "-inf" : Decimal(Decibels(), 1);
}

std::optional<float> Gain::Read(std::int32_t index, const std::string& text) const
{
    if (index == kBypass)
        return text == "On" ? 1.0F : 0.0F;
    if (text.starts_with("-inf"))
        return 0.0F;
    const auto decibels = Number(text);
    return decibels ? std::optional(std::clamp((*decibels - kLowest) / kRange, 0.0F, 1.0F)) : std::nullopt;
}

long long Gain::Answer(const Call& call)
{
    if (call.opcode == effSetSpeakerArrangement)
        // A pointer travels in the value.
        return Arrange(reinterpret_cast<const VstSpeakerArrangement*>(call.value),
                       static_cast<const VstSpeakerArrangement*>(call.ptr));
    if (call.opcode == effGetSpeakerArrangement && mArrangements[0].numChannels > 0)
    {
        *reinterpret_cast<VstSpeakerArrangement**>(call.value) = mArrangements.data();
        *static_cast<VstSpeakerArrangement**>(call.ptr) = &mArrangements[1];
        return 1;
    }
    return 0;
}

long long Gain::Arrange(const VstSpeakerArrangement* input, const VstSpeakerArrangement* output)
{
    if (input == nullptr || output == nullptr || !IsKnown(*input) || !IsKnown(*output) || input->type != output->type)
        return 0;
    mArrangements = {*input, *output};
    SetChannels(input->numChannels, output->numChannels);
    return 1;
}

} // namespace

std::unique_ptr<Effect> MakeEffect(audioMasterCallback host)
{
    return std::make_unique<Gain>(host);
}

} // namespace effects::vst2
