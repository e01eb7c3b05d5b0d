#pragma once

#include "catalogue/BinaryStamps.h"
#include "catalogue/BlockReasons.h"

#include <foundation/zebcore/StringTypes.h>

#include <optional>
#include <string>

namespace zebhost
{

// Something that a scan has found out about a plug-in, as it stands in a line of the journal.
struct ScanFact
{
    zebaudiofilterhost::PluginLocator plugin;
    std::optional<BlockReason> block;          // it is blocked now; without, it is not, or not any more
    std::optional<BinaryStamps::Entry> result; // of its binary
    zebcore::UTF8String found;                 // its record and descriptors; empty leaves those that there are
    bool isForgotten = false;                  // its record, descriptors and stamp are worth nothing any more
};

// With a line end, and none inside.
std::string ToLine(const ScanFact& fact);
// Nothing if the line is damaged.
std::optional<ScanFact> ParseScanFact(const std::string& line);

} // namespace zebhost
