#include "host/BannedPluginManager.h"
#include "tests/vst/support/SearchFolder.h"

#include <gtest/gtest.h>

#include <filesystem>

namespace zebaudiofilterhost::vst
{

namespace
{

using Paths = SearchFolder::Paths;

class VSTPluginSearchTest : public testing::Test
{
protected:
    SearchFolder mFolder;
};

TEST_F(VSTPluginSearchTest, BundlesByTheirSuffixDepthFirstAndLastFoundFirst)
{
    mFolder.MakeFolders({"a/Top.vst/Hidden.vst", "a/Upper.VST/Inside.vst", "a/Old.vst.bak", "a/m/deep/Deep.vst",
                         "a/m/Middle.vst", "a/z/Last.vst"});
    mFolder.Write("a/File.vst", "no folder");
    EXPECT_EQ(mFolder.Search("a"),
              (Paths{"a/Top.vst", "a/z/Last.vst", "a/m/Middle.vst", "a/m/deep/Deep.vst", "a/Upper.VST/Inside.vst"}));
    EXPECT_TRUE(mFolder.Search("nowhere").empty());
}

TEST_F(VSTPluginSearchTest, LinksDoNotMakeTheWalkEndless)
{
    mFolder.MakeFolders({"a/One.vst", "b/Two.vst"});
    std::filesystem::create_directory_symlink("../b", mFolder.Path("a/to_b"));
    std::filesystem::create_directory_symlink("../a", mFolder.Path("b/to_a"));
    std::filesystem::create_directory_symlink(".", mFolder.Path("a/self"));
    EXPECT_EQ(mFolder.Search("a"), (Paths{"a/One.vst", "a/to_b/Two.vst"}));
}

TEST_F(VSTPluginSearchTest, LeavesOutWhatIsBlocked)
{
    mFolder.MakeFolders({"a/Bad.vst", "a/Good.vst"});
    const PluginLocator bad(kTechnologyVST, mFolder.TextOf("a/Bad.vst"));
    BannedPluginManager::GetInstance().AddBannedPlugin(bad);
    EXPECT_EQ(mFolder.Search("a"), (Paths{"a/Good.vst"}));
    BannedPluginManager::GetInstance().RemoveBannedPlugin(bad);
    EXPECT_EQ(mFolder.Search("a").size(), 2U);
}

TEST(VSTTechnology, PathsOfItsOwn)
{
    EXPECT_TRUE(GetPathDisplayString(u"/x//y.vst") == u"/x//y.vst");
    EXPECT_TRUE(GetPrivateVSTPluginDirectory() == Dir::AppDir().FullPath() + u"/Plug-Ins/VST");
}

} // namespace

} // namespace zebaudiofilterhost::vst
