#pragma once

#include <host/PluginLocator.h>

#include <filesystem>
#include <map>
#include <string>

namespace zebhost
{

struct BlockReason
{
    std::string reason;
    std::string since; // UTC, as 2024-05-31T12:00:00Z
};

// Why plug-ins are blocked, in a file of its own beside the block list. Losing it loses nothing but the reasons, so a
// damaged file counts as empty.
class BlockReasons
{
public:
    explicit BlockReasons(std::filesystem::path file);

    void Load();
    // Throws zebcore's file_exception.
    void Save() const;

    // With the time of now.
    void Set(const zebaudiofilterhost::PluginLocator& locator, const std::string& reason);
    void Remove(const zebaudiofilterhost::PluginLocator& locator);
    // Both texts empty if nothing is known.
    BlockReason Get(const zebaudiofilterhost::PluginLocator& locator) const;

private:
    std::filesystem::path mFile;
    std::map<std::string, BlockReason> mReasons; // by the locator's text
};

} // namespace zebhost
