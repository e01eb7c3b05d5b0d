#include "render/ChannelRow.h"

#include <algorithm>

namespace zebhost
{

ChannelRow::ChannelRow(const Routing& routing, int block) : mBlock(static_cast<std::size_t>(block))
{
    for (int channel = 0; channel < routing.mainChannels; ++channel)
    {
        const bool isPadding = channel >= routing.fileChannels;
        if (!isPadding)
        {
            mFileInputs.push_back(NewRow());
        }
        const bool repeats = isPadding && routing.paddingSource >= 0;
        mInputs.push_back(!isPadding ? mFileInputs.back()
                          : repeats  ? mFileInputs[static_cast<std::size_t>(routing.paddingSource)]
                                     : NewRow());
        mOutputs.push_back(NewRow());
    }
    for (int channel = 0; channel < routing.sideChannels; ++channel)
    {
        if (channel < routing.sideFileChannels)
        {
            mSideInputs.push_back(NewRow());
        }
        // A side chain of one channel feeds all of the bus, as a single main channel does.
        const bool isPadding = channel >= routing.sideFileChannels;
        mInputs.push_back(!isPadding                      ? mSideInputs.back()
                          : routing.sideFileChannels == 1 ? mSideInputs.front()
                                                          : NewRow());
    }
}

float* ChannelRow::NewRow()
{
    return mRows.emplace_back(mBlock, 0.0F).data();
}

void ChannelRow::SilenceInputs()
{
    for (float* row : mFileInputs)
    {
        std::fill_n(row, mBlock, 0.0F);
    }
    for (float* row : mSideInputs)
    {
        std::fill_n(row, mBlock, 0.0F);
    }
}

void ChannelRow::SilenceOutputs()
{
    for (float* row : mOutputs)
    {
        std::fill_n(row, mBlock, 0.0F);
    }
}

} // namespace zebhost
