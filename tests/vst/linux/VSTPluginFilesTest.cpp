#include "tests/plugins/FixturePaths.h"
#include "tests/support/VariableGuard.h"
#include "tests/vst/support/SearchFolder.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <filesystem>
#include <string_view>

namespace zebaudiofilterhost::vst
{

namespace
{

using zebtest::VariableGuard;
using Paths = SearchFolder::Paths;

class VSTPluginFilesTest : public testing::Test
{
protected:
    void CopyFixture(std::string_view name, const std::string& target) const
    {
        std::filesystem::copy_file(zebtest::BinaryOf(zebtest::VST2Fixture(name)), mFolder.Path(target));
    }

    SearchFolder mFolder;
};

TEST_F(VSTPluginFilesTest, PlainFilesByWhatTheyExport)
{
    mFolder.MakeFolders({"a/deeper", "a/Bundle.vst", "a/Folder.so"});
    CopyFixture("Normal", "a/Plain.so");
    CopyFixture("MachoEntry", "a/deeper/Macho.so");
    CopyFixture("Normal", "a/Plain.so.1");
    CopyFixture("Normal", "a/Plain.dll");
    CopyFixture("Helper", "a/Helper.so");
    CopyFixture("OldMain", "a/OldMain.so");
    mFolder.Write("a/Text.so", "text");
    mFolder.Write("a/Empty.so", "");
    ASSERT_EQ(mkfifo(mFolder.Path("a/Pipe.so").c_str(), 0600), 0);
    std::filesystem::create_symlink("nowhere.so", mFolder.Path("a/Dangling.so"));
    std::filesystem::create_symlink("Plain.so", mFolder.Path("a/Alias.so"));
    EXPECT_EQ(mFolder.Search("a"),
              (Paths{"a/Bundle.vst", "a/Alias.so", "a/OldMain.so", "a/Plain.so", "a/deeper/Macho.so"}));
}

TEST_F(VSTPluginFilesTest, AFolderCalledLikeTheExtensionIsAFolder)
{
    mFolder.MakeFolders({"home/.vst/Inner.vst", "home/..vst"});
    EXPECT_EQ(mFolder.Search("home"), (Paths{"home/..vst", "home/.vst/Inner.vst"}));
    EXPECT_FALSE(IsVSTPlugin(mFolder.TextOf("home/.vst")));
}

TEST_F(VSTPluginFilesTest, BundlesOfOtherStandardsAreNotEntered)
{
    mFolder.MakeFolders({"a/One.vst3/Inner.vst", "a/Two.lv2/Inner.vst", "a/Three.clap", "a/Four.VST3/Inner.vst"});
    CopyFixture("Normal", "a/One.vst3/One.so");
    CopyFixture("Normal", "a/Two.lv2/Two.so");
    CopyFixture("Normal", "a/Three.clap/Three.so");
    EXPECT_EQ(mFolder.Search("a"), (Paths{"a/Four.VST3/Inner.vst"}));
    EXPECT_EQ(mFolder.Search("a/Two.lv2"), (Paths{"a/Two.lv2/Inner.vst", "a/Two.lv2/Two.so"}))
        << "unless it is asked for";
}

TEST_F(VSTPluginFilesTest, PlacesOfTheMachineFirst)
{
    const VariableGuard home("HOME", "/home/someone");
    const std::vector<UTF16String> standard = {u"/usr/lib/vst", u"/usr/lib/lxvst", u"/usr/local/lib/vst",
                                               u"/home/someone/.vst", u"/home/someone/.lxvst"};
    {
        const VariableGuard noPath("VST_PATH", "");
        EXPECT_TRUE(GetDefaultVSTPluginDirectories() == standard);
        const VariableGuard noHome("HOME", "");
        EXPECT_EQ(GetDefaultVSTPluginDirectories().size(), 3U);
    }
    const VariableGuard path("VST_PATH", "/b::/a/x y:here");
    const UTF16String here =
        zebcore::filesupport::FromNativePath((std::filesystem::current_path() / "here").native());
    EXPECT_TRUE(GetDefaultVSTPluginDirectories() == (std::vector<UTF16String>{u"/b", u"/a/x y", here}));
}

} // namespace

} // namespace zebaudiofilterhost::vst
