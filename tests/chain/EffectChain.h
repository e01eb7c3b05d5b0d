#pragma once

#include "audiofilter/AudioFilter.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <filesystem>
#include <string>
#include <vector>

namespace chain
{

using FilterPtr = boost::intrusive_ptr<zebaudiofilterhost::AudioFilter>;
using Channels = std::vector<std::vector<float>>;

inline constexpr int kChannels = 6; // of the application: 5.1
inline constexpr int kFrames = 256; // in a block

// What came out of a chain, and behind each of its filters the channels that were flagged silent, for each block.
struct Rendered
{
    Channels sound;
    std::vector<std::vector<unsigned long long>> silent;
};

// The effects of a track in an application, one behind the other, and what the application keeps of them in a file.
class EffectChain
{
public:
    // From the catalogue. Throws std::runtime_error for a filter that is not there.
    explicit EffectChain(const std::vector<std::u16string>& names);

    // A proxy stands in for each filter that can't be made.
    static EffectChain Load(const std::filesystem::path& file);
    void Save(const std::filesystem::path& file) const;

    FilterPtr& operator[](std::size_t index) { return mFilters[index]; }
    std::size_t Count() const { return mFilters.size(); }

    // Puts the filter in the place of its proxy wherever that is possible.
    void WakeProxies();

    // Whole blocks only. Input blocks without any sound go in flagged as silent.
    Rendered Render(const Channels& input);

private:
    EffectChain() = default;

    void RenderBlock(Rendered& rendered, Channels& other, std::size_t first);

    std::vector<FilterPtr> mFilters;
};

// Makes a filter ready for the application's channels; its maps stay as they are.
void FitIn(zebaudiofilterhost::AudioFilter& filter);

} // namespace chain
