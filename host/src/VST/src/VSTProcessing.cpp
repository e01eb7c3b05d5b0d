// The process thread's part of the filter.

#include "foundation/zebaccelerate/FloatBuffer.h"
#include "host/src/VST/src/VSTAudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost::vst
{

void VSTPins::Connect(float** in, float** out, int offset, int frames)
{
    for (std::size_t channel = 0; channel < mInputChannels; ++channel)
        mInputs[channel] = in[channel] + offset;
    for (std::size_t channel = 0; channel < mOutputChannels; ++channel)
        mOutputs[channel] = out[channel] + offset;
    ConnectRest(mInputChannels, mOutputChannels, frames);
}

void VSTPins::ConnectMono(float** in, float** out, int offset, int frames, std::vector<float>& scratch)
{
    mInputs[0] = in[0] + offset;
    mInputs[1] = mInputs[0];
    mOutputs[0] = out[0] + offset;
    mOutputs[1] = static_cast<std::size_t>(frames) <= scratch.size() ? scratch.data() : mDiscard.data();
    ConnectRest(2, 2, frames);
}

void VSTPins::ConnectRest(std::size_t inputs, std::size_t outputs, int frames)
{
    if (inputs < mInputPins)
    {
        // A plug-in may have written to it.
        zebaccelerate::utility::Zero(static_cast<unsigned int>(frames), mSilence.data());
        std::fill(mInputs.data() + inputs, mInputs.data() + mInputPins, mSilence.data());
    }
    if (outputs < mOutputPins)
        std::fill(mOutputs.data() + outputs, mOutputs.data() + mOutputPins, mDiscard.data());
}

// Plug-ins of this technology know no silent channels: the flags are not read, and none is given back.
void VSTAudioFilter::Process(float** in, float** out, int frames, ChannelFlags /*inFlags*/, ChannelFlags& outFlags)
{
    outFlags = ChannelFlags();
    if (!GetEffect())
        return;
    try
    {
        // One call, unless the block is longer than Resume has been told.
        int offset = 0;
        do
        {
            const int slice = std::clamp(frames - offset, 0, mPins.GetMaxFrames());
            ProcessSlice(*GetEffect(), in, out, offset, slice);
            offset += slice;
        } while (offset < frames);
    }
    catch (...) // what a plug-in throws ends the block, and goes no further
    {
    }
}

void VSTAudioFilter::ProcessSlice(AEffect& effect, float** in, float** out, int offset, int frames)
{
    mPins.Follow(effect.numInputs, effect.numOutputs);
    if (mMonoThroughStereo)
        mPins.ConnectMono(in, out, offset, frames, mScratchOutput);
    else
        mPins.Connect(in, out, offset, frames);
    const bool replacing = (effect.flags & effFlagsCanReplacing) != 0;
    if (!replacing)
        ClearAccumulated(offset, frames);
    if (const AEffectProcessProc process = replacing ? effect.processReplacing : effect.process)
        process(&effect, mPins.GetInputs(), mPins.GetOutputs(), frames);
}

// The plug-in adds to the outputs, of which deliberately only as many frames are cleared as there are channels: the
// caller's content of the rest stays in the sum.
void VSTAudioFilter::ClearAccumulated(int offset, int frames)
{
    const int channels = std::min(mOutputChannelsToClear, mPins.GetOutputCount());
    const auto count = static_cast<unsigned int>(std::clamp(mOutputChannelsToClear - offset, 0, frames));
    for (int channel = 0; channel < channels; ++channel)
        zebaccelerate::utility::Zero(count, mPins.GetOutputs()[channel]);
}

} // namespace zebaudiofilterhost::vst
