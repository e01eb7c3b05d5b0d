#pragma once

#include <sndfile.h>

namespace zebhost
{

// Whether libsndfile writes such a file, found out by writing one in memory: sf_format_check also says yes to kinds
// and sample rates that are refused later.
bool IsWritable(const SF_INFO& info);

} // namespace zebhost
