#pragma once

#include <foundation/zebmediatypes/ChannelLayout.h>

#include <string>
#include <vector>

namespace zebhost
{

// "L", "R", "C", "LFE"; a channel without a name gets its number, from 1, and a single one "mono".
std::vector<std::string> ChannelNames(const zebmediatypes::ChannelLayout& layout);

// What a sound file of so many channels most likely holds; without labels where nobody could know.
zebmediatypes::ChannelLayout UsualLayout(int channels);

// Layouts of as many channels under other labels, for plug-ins that refuse the usual one.
std::vector<zebmediatypes::ChannelLayout> OtherLayouts(int channels);

// Reads "L,R" or "1,2" into channel indices of the layout, from 0. Throws a usage Failure for names that the layout
// does not have, and for doubles.
std::vector<int> ParseChannels(const std::string& text, const zebmediatypes::ChannelLayout& layout);

} // namespace zebhost
