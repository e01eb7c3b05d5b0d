#include "host/src/VST3/src/VST3PluginSearch.h"

#include "foundation/zebcore/NativePath.h"
#include "host/BannedPluginManager.h"
#include "host/VST3/VST3Technology.h"
#include "host/src/VST3/src/VST3Places.h"
#include "tests/support/VariableGuard.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

namespace fs = std::filesystem;

using zebtest::VariableGuard;

class VST3PluginSearchTest : public testing::Test
{
protected:
    VST3PluginSearchTest()
    {
        std::string name = (fs::temp_directory_path() / "zebvst3XXXXXX").string();
        mRoot = mkdtemp(name.data());
    }
    ~VST3PluginSearchTest() override { fs::remove_all(mRoot); }

    void MakeFolders(const std::vector<std::string>& paths) const
    {
        for (const std::string& path : paths)
            fs::create_directories(mRoot / path);
    }

    // Paths below the root, in the order in which they were found.
    std::vector<std::string> Search(const std::string& places) const
    {
        const VariableGuard guard("VST3_PATH", places);
        std::vector<std::string> found;
        for (const PluginLocator& locator : GetPotentialPluginLocators(Dir()))
        {
            EXPECT_EQ(locator.GetTechnologyType(), kTechnologyVST3);
            found.push_back(
                fs::path(zebcore::filesupport::ToNativePath(locator.GetPath())).lexically_relative(mRoot));
        }
        return found;
    }

    fs::path mRoot;
};

using Paths = std::vector<std::string>;

TEST_F(VST3PluginSearchTest, FindsBundlesByTheirSuffix)
{
    MakeFolders({"a/One.vst3/Contents", "a/Upper.VST3/Inside.vst3", "a/vst3", "a/Two.vst3.old", "a/.vst3"});
    std::ofstream(mRoot / "a/File.vst3") << "no folder";
    EXPECT_EQ(Search(mRoot / "a"), (Paths{"a/.vst3", "a/One.vst3", "a/Upper.VST3/Inside.vst3"}));
}

TEST_F(VST3PluginSearchTest, WalksDepthFirstAndLastFoundFirst)
{
    MakeFolders({"a/Top.vst3", "a/m/Mid.vst3/Hidden.vst3", "a/m/deep/Deep.vst3", "a/z/Last.vst3", "b/First.vst3"});
    EXPECT_EQ(Search((mRoot / "b").string() + "::" + (mRoot / "none").string() + ":" + (mRoot / "a").string()),
              (Paths{"b/First.vst3", "a/Top.vst3", "a/z/Last.vst3", "a/m/Mid.vst3", "a/m/deep/Deep.vst3"}));
}

TEST_F(VST3PluginSearchTest, LinksDoNotMakeTheWalkEndless)
{
    MakeFolders({"a/One.vst3", "b/Two.vst3"});
    fs::create_directory_symlink("../b", mRoot / "a/to_b");
    fs::create_directory_symlink("../a", mRoot / "b/to_a");
    fs::create_directory_symlink(".", mRoot / "a/self");
    fs::create_directory_symlink("nowhere", mRoot / "a/dangling");
    EXPECT_EQ(Search(mRoot / "a"), (Paths{"a/One.vst3", "a/to_b/Two.vst3"}));
    // Every folder of a row links to all others: without a memory, as many ways as orders of them.
    for (int from = 0; from < 12; ++from)
    {
        MakeFolders({"row/" + std::to_string(from)});
        for (int to = 0; to < 12; ++to)
            fs::create_directory_symlink("../" + std::to_string(to),
                                         mRoot / "row" / std::to_string(from) / ("to" + std::to_string(to)));
    }
    MakeFolders({"row/7/Seven.vst3"});
    EXPECT_EQ(Search(mRoot / "row").size(), 1U);
}

TEST_F(VST3PluginSearchTest, LinksToBundlesCount)
{
    MakeFolders({"a", "elsewhere/Real"});
    fs::create_directory_symlink(mRoot / "elsewhere/Real", mRoot / "a/Linked.vst3");
    EXPECT_EQ(Search(mRoot / "a"), Paths{"a/Linked.vst3"});
}

TEST_F(VST3PluginSearchTest, LeavesOutWhatIsBanned)
{
    MakeFolders({"a/Bad.vst3", "a/Good.vst3"});
    const PluginLocator bad(kTechnologyVST3, zebcore::filesupport::FromNativePath((mRoot / "a/Bad.vst3").string()));
    BannedPluginManager::GetInstance().AddBannedPlugin(bad);
    EXPECT_EQ(Search(mRoot / "a"), Paths{"a/Good.vst3"});
    BannedPluginManager::GetInstance().RemoveBannedPlugin(bad);
    EXPECT_EQ(Search(mRoot / "a").size(), 2U);
}

TEST(VST3Places, UserFirst)
{
    const VariableGuard noPath("VST3_PATH", "");
    const VariableGuard home("HOME", "/home/someone");
    std::vector<std::u16string> places;
    for (const Dir& place : GetVST3Places())
        places.push_back(place.FullPath());
    const std::vector<std::u16string> expected = {u"/home/someone/.vst3", u"/usr/local/lib/vst3", u"/usr/lib/vst3"};
    EXPECT_TRUE(places == expected);
}

TEST(VST3Technology, DirectoriesOfItsOwn)
{
    EXPECT_TRUE(GetDefaultVST3PluginDirectories().empty());
    EXPECT_TRUE(GetPathDisplayString(u"/x//y.vst3") == u"/x//y.vst3");
    EXPECT_TRUE(GetPrivateVST3PluginDirectory() == Dir::AppDir().FullPath() + u"/Plug-Ins/VST3");
}

} // namespace

} // namespace zebaudiofilterhost::vst3
