#pragma once

#include <host/PluginLocator.h>

#include <filesystem>
#include <string>
#include <vector>

namespace zebhost
{

// Whether the path is named like a plug-in, bundle or file, of a technology that the library knows; nothing is
// opened.
bool IsBundlePath(const std::filesystem::path& path);

// The locators of what is at the path: one, with an absolute path without dots in it, but for an Audio Unit bundle
// one for each unit in it. None if IsBundlePath is false.
std::vector<zebaudiofilterhost::PluginLocator> PluginsAt(const std::filesystem::path& path);

// Ends of sentences: what such names end in, and what to say of an Audio Unit bundle in which there is none.
extern const char* const kPluginNameEnds;
extern const char* const kHoldsNoUnit;

std::string PathOf(const zebaudiofilterhost::PluginLocator& locator);

// For the user's eyes: the path, and for a plug-in that is no file the name by which its system knows it, or, if it
// does not know it any more, the four characters of type, subtype and maker.
std::string PlaceOf(const zebaudiofilterhost::PluginLocator& locator);

// What a command takes: the path, and for a plug-in that is no file its ID.
std::string SelectorOf(const zebaudiofilterhost::PluginLocator& locator);
// As one word for a shell.
std::string ShellWord(const std::string& text);
std::string SelectorWord(const zebaudiofilterhost::PluginLocator& locator);

// Whether the text is the path's last part; of a plug-in that is no file, what PlaceOf shows.
bool IsCalled(const zebaudiofilterhost::PluginLocator& locator, const std::string& text);

// Whether the plug-in's file or bundle is there; for one that is no file, whether its technology still finds it.
bool IsInstalled(const zebaudiofilterhost::PluginLocator& locator);

// Has a scan without paths search what the environment says now, and not the folders that the settings file holds:
// they were those of an environment gone by.
void UseStandardPlaces();

// The plug-in itself, or all plug-ins below a folder, in the order of their names; the inside of a bundle is not
// searched, and a plain file is looked into without loading it. Throws a Failure if there is nothing at the path,
// or nothing that can be read.
std::vector<zebaudiofilterhost::PluginLocator> FindPlugins(const std::filesystem::path& path);

// Without those that a symbolic link leads to a second time; the first of each stays.
std::vector<zebaudiofilterhost::PluginLocator>
WithoutDoubles(const std::vector<zebaudiofilterhost::PluginLocator>& locators);

} // namespace zebhost
