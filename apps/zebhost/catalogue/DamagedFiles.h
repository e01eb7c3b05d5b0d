#pragma once

#include "output/Console.h"

#include <filesystem>
#include <set>

namespace zebhost
{

// Files that count as missing, since they are damaged or of another version. Tells the user of each.
class DamagedFiles
{
public:
    explicit DamagedFiles(Console& console) : mConsole(console) {}

    void Note(const std::filesystem::path& path);
    // To be called before a new one takes its place: if it was noted, it is given another name. Throws
    // filesystem_error.
    void SetAside(const std::filesystem::path& path);

private:
    Console& mConsole;
    std::set<std::filesystem::path> mPaths;
};

} // namespace zebhost
