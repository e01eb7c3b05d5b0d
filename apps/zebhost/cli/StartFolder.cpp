#include "cli/StartFolder.h"

#include <system_error>

namespace zebhost::startfolder
{

namespace
{

std::filesystem::path sFolder;

} // namespace

// A folder below one that is closed to this user can be worked in, but not be reached by its full path: there paths
// stay relative.
void Remember()
{
    std::error_code error;
    const std::filesystem::path folder = std::filesystem::current_path(error);
    if (!error && std::filesystem::equivalent(folder, ".", error))
    {
        sFolder = folder;
    }
}

std::filesystem::path Resolve(const std::filesystem::path& path)
{
    return sFolder / path;
}

} // namespace zebhost::startfolder
