#pragma once

#include "foundation/zebcore/NativePath.h"
#include "host/VST/VSTTechnology.h"
#include "host/src/VST/src/VSTPluginSearch.h"
#include "tests/persistence/TempFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>
#include <vector>

namespace zebaudiofilterhost::vst
{

// A folder of plug-ins to be found.
class SearchFolder
{
public:
    using Paths = std::vector<std::string>;

    void MakeFolders(const Paths& paths) const
    {
        for (const std::string& path : paths)
            std::filesystem::create_directories(mFolder.Path(path));
    }

    UTF16String TextOf(const std::string& path) const
    {
        return zebcore::filesupport::FromNativePath(mFolder.Path(path).string());
    }

    // Paths below the folder, in the order in which they were found.
    Paths Search(const std::string& folder) const
    {
        Paths found;
        for (const PluginLocator& locator : GetPotentialPluginLocators(Dir(TextOf(folder))))
        {
            EXPECT_EQ(locator.GetTechnologyType(), kTechnologyVST);
            EXPECT_TRUE(IsVSTPlugin(locator.GetPath()));
            const std::filesystem::path path = zebcore::filesupport::ToNativePath(locator.GetPath());
            found.push_back(path.lexically_relative(mFolder.Path()));
        }
        return found;
    }

    std::filesystem::path Path(const std::string& path) const { return mFolder.Path(path); }
    void Write(const std::string& path, const std::string& content) const { mFolder.Write(path, content); }

private:
    TempFolder mFolder;
};

} // namespace zebaudiofilterhost::vst
