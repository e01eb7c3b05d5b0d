#pragma once

#include "utility/CommonTypes.h"

#include <vector>

namespace zebaudiofilterhost::vst
{

// What this system's VST 2 plug-ins are on disk, besides the bundles that all systems have. Files are read here, and
// never loaded.

/// Whether a plain file is a plug-in. [main]
bool IsPluginFile(const UTF16String& path);

/// The plug-ins among a directory's plain files, in the order of their names. [main]
std::vector<UTF16String> FindPluginFiles(const Dir& directory);

/// Whether a directory whose path ends in ".vst" is a bundle. [any]
bool IsBundleName(const UTF16String& path);

/// False for the bundles of other plug-in standards, whose binaries may export a VST 2 entry point as well. [main]
bool IsSearchedDirectory(const UTF16String& path);

/// The names of GetVSTEntryPoints, in their order, that this bundle or file has itself, and not some library that it
/// needs; all of them if that is not known without loading. [main]
std::vector<const char*> FindEntryPoints(const UTF16String& path);

/// Why loading this bundle or file cannot give a plug-in: a sentence that names it. Empty if it can, or if that is
/// not known without loading. [main]
UTF16String FindPluginProblem(const UTF16String& path);

} // namespace zebaudiofilterhost::vst
