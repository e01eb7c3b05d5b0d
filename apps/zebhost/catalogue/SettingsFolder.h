#pragma once

#include <foundation/zebcore/File.h>

#include <filesystem>
#include <string>

namespace zebhost
{

// Where catalogue, block lists and presets lie.
class SettingsFolder
{
public:
    // Empty for the user's preference folder. Otherwise the library is told to take this one too. [main]
    explicit SettingsFolder(const std::string& folder);

    const std::filesystem::path& Path() const { return mPath; }
    std::filesystem::path Catalogue() const;
    std::filesystem::path BinaryStamps() const;
    std::filesystem::path Journal() const;
    std::filesystem::path Blocks() const;
    std::filesystem::path BlockReasons() const;
    std::filesystem::path PermanentBlocks() const;
    std::filesystem::path Presets() const;

private:
    std::filesystem::path mPath;
};

zebcore::filesupport::File ToFile(const std::filesystem::path& path);

} // namespace zebhost
