#pragma once

#include <filesystem>

// The working directory belongs to the whole process, and plug-ins change it. So a path that the user gave is turned
// into one from the start folder wherever a file is touched; messages show it as it was given.
namespace zebhost::startfolder
{

// To be called before any plug-in is loaded. [main]
void Remember();

// What the path led to at the start, whatever the working directory is by now.
std::filesystem::path Resolve(const std::filesystem::path& path);

} // namespace zebhost::startfolder
