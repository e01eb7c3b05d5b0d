#pragma once

#include "catalogue/Catalogue.h"

#include <audiofilter/AudioFilter.h>

#include <string>

namespace zebhost
{

using FilterPointer = boost::intrusive_ptr<zebaudiofilterhost::AudioFilter>;

inline constexpr unsigned int kDefaultSettleMs = 50;

// Makes a filter of the catalogue. Throws a Failure that tells why it cannot be made. The filter is suspended, and
// the plug-in's timers have been served for `settleMs`. [main]
FilterPointer LoadFilter(const Catalogue::Descriptor& descriptor, unsigned int settleMs = kDefaultSettleMs);

// Serves timers and descriptors of plug-ins: some finish their set-up there, and are silent until then. [main]
void Settle(unsigned int milliseconds);

} // namespace zebhost
