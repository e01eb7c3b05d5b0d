#include "host/src/VST/src/VSTPins.h"

#include <algorithm>

namespace zebaudiofilterhost::vst
{

namespace
{

// Some plug-ins touch more pins than they tell of, or grow some when they are switched on.
constexpr std::size_t kSparePointers = 64;

// Mono buses may stand before two pins.
constexpr int kMinPins = 2;

// What the plug-in was told when it was opened.
constexpr int kMinFrames = 2048;

std::size_t PinCount(int pins, int channels)
{
    return static_cast<std::size_t>(std::clamp(std::max(pins, channels), kMinPins, VSTPins::kMaxPins));
}

std::size_t ChannelCount(int channels)
{
    return static_cast<std::size_t>(std::clamp(channels, 0, VSTPins::kMaxPins));
}

} // namespace

void VSTPins::Prepare(int inputPins, int outputPins, int inputChannels, int outputChannels, int blockSize)
{
    mInputChannels = ChannelCount(inputChannels);
    mOutputChannels = ChannelCount(outputChannels);
    mInputPins = PinCount(inputPins, inputChannels);
    mOutputPins = PinCount(outputPins, outputChannels);
    const auto frames = static_cast<std::size_t>(std::max(blockSize, kMinFrames));
    mSilence.assign(frames, 0.0F);
    mDiscard.assign(frames, 0.0F);
    mInputs.assign(mInputPins + kSparePointers, mSilence.data());
    mOutputs.assign(mOutputPins + kSparePointers, mDiscard.data());
}

} // namespace zebaudiofilterhost::vst
