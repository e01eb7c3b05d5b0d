#pragma once

#include "catalogue/BinaryStamp.h"
#include "catalogue/LocatorTable.h"

#include <optional>
#include <string>
#include <vector>

namespace zebhost
{

// Which binaries were scanned, in a file of its own beside the settings file: a binary that is not the one that was
// scanned is scanned again, and one that could not be loaded is left alone for as long as it is the same.
class BinaryStamps
{
public:
    explicit BinaryStamps(const std::filesystem::path& file);

    // False if the file is damaged. Throws zebcore's file_exception.
    bool Load() { return mTable.Load(); }
    // Throws zebcore's file_exception, or filesystem_error.
    void Save(LocatorTable::Saving saving) const { mTable.Save(saving); }

    struct Entry
    {
        BinaryStamp binary;
        std::string problem; // why it could not be loaded; empty if it could
        std::string visit;   // of the scan that found this out: see BlockReason
    };
    static Json ToJson(const Entry& entry);
    static Entry EntryIn(const Json& json);
    std::optional<Entry> Find(const zebaudiofilterhost::PluginLocator& locator) const;
    void Set(const zebaudiofilterhost::PluginLocator& locator, const Entry& entry);
    void Remove(const zebaudiofilterhost::PluginLocator& locator) { mTable.Remove(locator); }

    // The next scan tries these, wherever they lie and whatever became of them before. What it finds out takes the
    // mark away.
    void MarkToBeTried(const zebaudiofilterhost::PluginLocator& locator);
    bool IsToBeTried(const zebaudiofilterhost::PluginLocator& locator) const;
    std::vector<zebaudiofilterhost::PluginLocator> AllToBeTried() const;

private:
    LocatorTable mTable;
};

} // namespace zebhost
