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
    std::u16string_view mBundleExtension; // as for IsNamedAsBundle
    /// Whether to search a directory that is no plug-in; null for all.
    bool (*mIsSearched)(const UTF16String& path) = nullptr;
    /// The plug-ins that are plain files of a directory; null for none.
    std::vector<UTF16String> (*mFindFiles)(const Dir& directory) = nullptr;
};

/// Whether a path ends in a bundle's extension, letter by letter, with a name before it: a folder that is called like
/// the extension alone holds plug-ins and is none. [any]
bool IsNamedAsBundle(std::u16string_view path, std::u16string_view extension);

/// The plug-ins below the places, without those that the dynamic block list names. Each place is walked depth-first,
/// last-found directory first; a bundle is not entered, and a directory that links lead to again is not walked again.
/// [main]
std::vector<PluginLocator> SearchForPlugins(const std::vector<Dir>& places, const PluginSearchRules& rules);

} // namespace zebaudiofilterhost
