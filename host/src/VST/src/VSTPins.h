#pragma once

#include <cstddef>
#include <vector>

namespace zebaudiofilterhost::vst
{

/// The pointers that a process function gets: one for each pin of the plug-in and some more, whatever its counts and
/// the buses say. Pins beyond the buses' channels read silence and write where nobody reads.
class VSTPins
{
public:
    /// Pins beyond these are a lie of the plug-in's.
    static constexpr int kMaxPins = 4096;

    /// Sizes everything for buses with so many channels, and for as many pins as there may be. [main, suspended]
    void Prepare(int inputChannels, int outputChannels, int blockSize);

    /// What the plug-in says of its pins now; to be told ahead of each Connect or ConnectMono. [process]
    void Follow(int inputPins, int outputPins);

    /// Most frames that the pins beyond the buses can take at once; 1 or more behind Prepare. [process]
    int GetMaxFrames() const { return static_cast<int>(mSilence.size()); }

    /// Connects the buses' channels from a frame on, and the other pins for `frames`. [process]
    void Connect(float** in, float** out, int offset, int frames);
    /// Connects one channel to both input pins, and the first output pin to one channel; the second one writes into
    /// `scratch` as far as that reaches. [process]
    void ConnectMono(float** in, float** out, int offset, int frames, std::vector<float>& scratch);

    /// Valid until the next Prepare. [process]
    float** GetInputs() { return mInputs.data(); }
    float** GetOutputs() { return mOutputs.data(); }
    int GetOutputCount() const { return static_cast<int>(mOutputs.size()); }

private:
    void ConnectRest(std::size_t inputs, std::size_t outputs, int frames);

    std::vector<float*> mInputs;
    std::vector<float*> mOutputs;
    std::size_t mInputPins = 0; // that are connected anew for each block; those behind them stay as they are
    std::size_t mOutputPins = 0;
    std::size_t mInputChannels = 0;
    std::size_t mOutputChannels = 0;
    std::vector<float> mSilence;
    std::vector<float> mDiscard;
};

} // namespace zebaudiofilterhost::vst
