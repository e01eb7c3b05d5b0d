#include "host/src/VST/src/VSTPins.h"

#include <algorithm>

namespace zebaudiofilterhost::vst
{

namespace
{

// Some plug-ins touch more pins than they tell of.
constexpr std::size_t kSparePointers = 64;

// Mono buses may stand before two pins.
constexpr int kMinPins = 2;

// What the plug-in was told when it was opened.
constexpr int kMinFrames = 2048;

std::size_t PinCount(int pins)
{
    return static_cast<std::size_t>(std::clamp(pins, kMinPins, VSTPins::kMaxPins));
}

std::size_t ChannelCount(int channels)
{
    return static_cast<std::size_t>(std::clamp(channels, 0, VSTPins::kMaxPins));
}

} // namespace

// Always for all pins that there may be: a plug-in may grow some whenever it is called, in the middle of being
// switched on for instance.
void VSTPins::Prepare(int inputChannels, int outputChannels, int blockSize)
{
    mInputChannels = ChannelCount(inputChannels);
    mOutputChannels = ChannelCount(outputChannels);
    const auto frames = static_cast<std::size_t>(std::max(blockSize, kMinFrames));
    mSilence.assign(frames, 0.0F);
    mDiscard.assign(frames, 0.0F);
    mInputs.assign(kMaxPins + kSparePointers, mSilence.data());
    mOutputs.assign(kMaxPins + kSparePointers, mDiscard.data());
}

void VSTPins::Follow(int inputPins, int outputPins)
{
    mInputPins = PinCount(inputPins);
    mOutputPins = PinCount(outputPins);
}

} // namespace zebaudiofilterhost::vst
