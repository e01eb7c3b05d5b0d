#pragma once

#include <audiofilter/AudioFilter.h>

#include <vector>

namespace zebhost
{

// How the channels of a file, and of a side-chain file, meet those of a plug-in. The application's row of channels is
// the main channels, then those of the side chain; a channel map puts the plug-in's channels on it.
//
// Where the plug-in has more channels than the file, the row gets padding behind the file's channels: a single
// channel feeds all inputs of the plug-in, and outputs without a channel in the file are dropped.
struct Routing
{
    int fileChannels = 0;
    int mainChannels = 0; // with the padding
    int sideFileChannels = 0;
    int sideChannels = 0;
    zebmediatypes::ChannelMap inputMap;
    zebmediatypes::ChannelMap outputMap;
    std::vector<int> processed; // file channels that the plug-in writes
    int paddingSource = -1;     // the file channel that padding repeats; -1 for silence
};

// What a user asked for.
struct RoutingRequest
{
    zebmediatypes::ChannelLayout file;
    std::vector<int> on;                    // file channels in the order of the plug-in's; empty for the best fit
    zebmediatypes::ChannelLayout sideChain; // empty without one
};

// Asks a suspended filter for buses that fit the request, gives it target buses and maps, and returns the routing.
// Throws a Failure when the plug-in has nowhere to put the channels. [main, suspended]
Routing RouteFilter(zebaudiofilterhost::AudioFilter& filter, const RoutingRequest& request);

} // namespace zebhost
