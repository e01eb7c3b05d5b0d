#pragma once

#include "host/PluginLocator.h"
#include "utility/CommonTypes.h"

#include <string_view>
#include <vector>

namespace zebaudiofilterhost
{

/// What a technology's plug-ins look like on disk.
struct PluginSearchRules
{
    TechnologyType mType;
    std::u16string_view mBundleExtension; // ends the path of a directory that is a plug-in, letter by letter
    /// Whether a directory with that extension is a plug-in; null for all.
    bool (*mIsBundle)(const UTF16String& path) = nullptr;
    /// Whether to search a directory that is no plug-in; null for all.
    bool (*mIsSearched)(const UTF16String& path) = nullptr;
    /// The plug-ins that are plain files of a directory; null for none.
    std::vector<UTF16String> (*mFindFiles)(const Dir& directory) = nullptr;
};

/// Whether a path is that of a directory that is a plug-in; nothing is looked up. [any]
bool IsNamedAsBundle(const UTF16String& path, const PluginSearchRules& rules);

/// The plug-ins below the places, without those that the dynamic block list names. Each place is walked depth-first,
/// last-found directory first; a bundle is not entered, and a directory that links lead to again is not walked again.
/// [main]
std::vector<PluginLocator> SearchForPlugins(const std::vector<Dir>& places, const PluginSearchRules& rules);

} // namespace zebaudiofilterhost
