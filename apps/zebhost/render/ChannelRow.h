#pragma once

#include "render/Routing.h"

#include <vector>

namespace zebhost
{

// The buffers of one block, in the application's row of channels, as ProcessWithMapping wants them.
class ChannelRow
{
public:
    ChannelRow(const Routing& routing, int block);

    // Rows for a file's channels, to be filled before each block.
    float* const* FileInputs() { return mFileInputs.data(); }
    float* const* SideInputs() { return mSideInputs.data(); }
    void SilenceInputs();

    float** Inputs() { return mInputs.data(); }
    float** Outputs() { return mOutputs.data(); }
    // What a block leaves alone is silence.
    void SilenceOutputs();

private:
    float* NewRow();

    std::size_t mBlock;
    std::vector<std::vector<float>> mRows;
    std::vector<float*> mFileInputs;
    std::vector<float*> mSideInputs;
    std::vector<float*> mInputs;
    std::vector<float*> mOutputs;
};

} // namespace zebhost
