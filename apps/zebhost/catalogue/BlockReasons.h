#pragma once

#include "catalogue/BinaryStamp.h"
#include "catalogue/LocatorTable.h"

#include <filesystem>
#include <string>

namespace zebhost
{

struct BlockReason
{
    std::string reason;
    std::string since; // UTC, as 2024-05-31T12:00:00Z
    // Of the binary that a scan blocked; another one is given a chance. Empty for a block made by hand, which holds
    // until it is lifted by hand.
    BinaryStamp binary;
    // Of a scan that has not ended, or was killed.
    bool isAtHand = false;
    bool wasKnown = false; // while at hand: the catalogue has a record of an earlier scan
    std::string visit;     // while at hand: stands in BinaryStamps as well once the result is saved
    bool isByHand = false; // no scan offers it again
};

// The time of now, as it stands in `since`.
std::string TimeOfNow();

Json ToJson(const BlockReason& reason);
// All that is missing stays empty.
BlockReason BlockReasonIn(const Json& entry);

// Why plug-ins are blocked, in a file of its own beside the block list. Losing it loses nothing but the reasons.
class BlockReasons
{
public:
    explicit BlockReasons(const std::filesystem::path& file);

    // False if the file is damaged. Throws zebcore's file_exception.
    bool Load() { return mTable.Load(); }
    // Throws zebcore's file_exception, or filesystem_error.
    void Save(LocatorTable::Saving saving) const { mTable.Save(saving); }

    void Set(const zebaudiofilterhost::PluginLocator& locator, const BlockReason& reason);
    void Remove(const zebaudiofilterhost::PluginLocator& locator) { mTable.Remove(locator); }
    // All empty if nothing is known.
    BlockReason Get(const zebaudiofilterhost::PluginLocator& locator) const;

private:
    LocatorTable mTable;
};

} // namespace zebhost
