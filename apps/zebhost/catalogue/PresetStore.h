#pragma once

#include <audiofilter/AudioFilter.h>

#include <filesystem>
#include <string>
#include <vector>

namespace zebhost
{

// Presets as files, one each: in the settings folder under a filter's ID and a name, or anywhere under a path. [main]
class PresetStore
{
public:
    struct Entry
    {
        std::string name;
        std::string filterID;
        std::string filterName;
        std::filesystem::path file;
    };

    explicit PresetStore(std::filesystem::path folder);

    // Something with a slash in it, or ending in .xml, is a file; anything else a name in the store.
    static bool IsFile(const std::string& preset);

    // Saves what the filter has now. Throws a Failure when there is one and `overwrite` is false, or when it cannot
    // be written. Returns where it lies.
    std::filesystem::path Save(zebaudiofilterhost::AudioFilter& filter, const std::string& preset, bool overwrite);

    // Whether there is such a preset, file or name.
    bool Has(const zebaudiofilterhost::AudioFilter& filter, const std::string& preset) const;

    // Throws a Failure if there is none, if it is no preset, belongs to another filter, or is refused.
    void Load(zebaudiofilterhost::AudioFilter& filter, const std::string& preset) const;

    // Of one filter, or with an empty ID of all, by name.
    std::vector<Entry> List(const std::string& filterID) const;

private:
    std::filesystem::path FileOf(const std::string& filterID, const std::string& preset) const;

    std::filesystem::path mFolder;
};

} // namespace zebhost
