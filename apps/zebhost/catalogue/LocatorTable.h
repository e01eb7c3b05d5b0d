#pragma once

#include "output/JsonDocument.h"

#include <host/PluginLocator.h>

#include <filesystem>
#include <map>
#include <string>

namespace zebhost
{

// A JSON file with something to remember of each of some plug-ins. What stands in it can be found out again, or be
// done without, so a file that is damaged or of another version counts as empty.
class LocatorTable
{
public:
    LocatorTable(std::filesystem::path file, std::string section);

    // False if there is a file, and not all of it could be taken. Throws zebcore's file_exception if it cannot be
    // read.
    bool Load();

    enum class Saving
    {
        Flushed, // outlives a power failure
        Quick    // outlives the end of the process, in any way, and is a hundred times quicker
    };
    // The old file or the new one is there, whole. Throws zebcore's file_exception, or filesystem_error.
    void Save(Saving saving) const;

    // Null if there is no entry.
    const Json* Find(const zebaudiofilterhost::PluginLocator& locator) const;
    void Set(const zebaudiofilterhost::PluginLocator& locator, Json entry);
    void Remove(const zebaudiofilterhost::PluginLocator& locator);
    // By keys that are good for nothing but telling entries apart.
    const std::map<std::string, Json>& Entries() const { return mEntries; }

private:
    void SaveQuickly(const std::string& text) const;

    std::filesystem::path mFile;
    std::string mSection;
    std::map<std::string, Json> mEntries; // by the locator's text
};

// A text of an entry; empty if it has none of that name.
std::string TextIn(const Json& entry, const char* name);

} // namespace zebhost
