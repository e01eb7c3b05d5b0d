#pragma once

#include <vector>

namespace zebaudiofilterhost::vst
{

/// The pointers that a process function gets: one for each pin of the plug-in and some more, whatever its counts and
/// the buses say. Pins beyond the buses' channels read silence and write where nobody reads.
class VSTPins
{
public:
    /// Sizes everything for a plug-in with so many pins, and buses with so many channels. Counts that no plug-in has
    /// are not believed. [main, suspended]
    void Prepare(int inputPins, int outputPins, int inputChannels, int outputChannels, int blockSize);

    /// Largest number of frames that the pins beyond the buses can take. Never 0 behind Prepare. [process]
    int GetMaxFrames() const { return static_cast<int>(mSilence.size()); }

    /// Connects the buses' channels from a frame on, and all other pins for `frames`. [process]
    void Connect(float** in, float** out, int offset, int frames);
    /// The one channel to both input pins, and from the first output pin; the second one writes into `scratch` as far
    /// as that reaches. [process]
    void ConnectMono(float** in, float** out, int offset, int frames, std::vector<float>& scratch);

    /// Valid until the next Prepare. [process]
    float** GetInputs() { return mInputs.data(); }
    float** GetOutputs() { return mOutputs.data(); }
    int GetOutputCount() const { return static_cast<int>(mOutputs.size()); }

private:
    void ConnectBeyond(std::size_t inputs, std::size_t outputs, int frames);

    std::vector<float*> mInputs;
    std::vector<float*> mOutputs;
    std::size_t mInputPins = 0; // what the plug-in has
    std::size_t mInputChannels = 0;
    std::size_t mOutputChannels = 0;
    std::vector<float> mSilence;
    std::vector<float> mDiscard;
};

} // namespace zebaudiofilterhost::vst
