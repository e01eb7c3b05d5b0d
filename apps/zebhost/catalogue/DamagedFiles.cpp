#include "catalogue/DamagedFiles.h"

#include <string>

namespace zebhost
{

namespace
{

std::filesystem::path FreeName(const std::filesystem::path& path)
{
    for (int number = 1;; ++number)
    {
        std::filesystem::path candidate = path;
        candidate += ".damaged-" + std::to_string(number);
        if (!std::filesystem::exists(std::filesystem::symlink_status(candidate)))
        {
            return candidate;
        }
    }
}

} // namespace

void DamagedFiles::Note(const std::filesystem::path& path)
{
    mPaths.insert(path);
    mConsole.Warn("zebhost: " + path.string() +
                  " is damaged or of another version, and was ignored; it will be kept under another name when a new "
                  "one is saved");
}

void DamagedFiles::SetAside(const std::filesystem::path& path)
{
    if (mPaths.erase(path) != 0)
    {
        const std::filesystem::path aside = FreeName(path);
        std::filesystem::rename(path, aside);
        mConsole.Warn("zebhost: the damaged file is kept as " + aside.string());
    }
}

} // namespace zebhost
