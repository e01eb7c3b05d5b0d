#pragma once

#include "audiofilter/AudioFilter.h"
#include "host/AudioFilterDescriptor.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <filesystem>
#include <vector>

namespace zebtest
{

using FilterPtr = boost::intrusive_ptr<zebaudiofilterhost::AudioFilter>;
using DescriptorPtr = boost::intrusive_ptr<zebaudiofilterhost::AudioFilterDescriptor>;

// Scans one bundle, or one VST 2 file, as an application does. What it holds, in its order.
std::vector<DescriptorPtr> Scan(const std::filesystem::path& bundle);

// The filter of the bundle's first descriptor, made through the catalogue; null if there is none.
FilterPtr MakeFilter(const std::filesystem::path& bundle);

// Sends blocks of a constant through the filter, which is resumed before and suspended after. Gives the last block of
// output: as many channels as the plug-in has, each of so many frames.
std::vector<std::vector<float>> RunBlocks(zebaudiofilterhost::AudioFilter& filter, int blocks, int frames);

} // namespace zebtest
