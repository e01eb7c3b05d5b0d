#include "utility/PrivatePluginUtils.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/XmlUtils.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "tests/host/FakeTechnology.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <stdexcept>
#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;
using zebcore::filesupport::ToNativePath;

/// An imaginary machine whose plug-ins have folders on the disk, and preferences of its own.
class PrivatePluginConfigTest : public FakeTechnologyFixture
{
protected:
    PrivatePluginConfigTest() { Dir::SetPrefDir(Dir(PathInFolder("preferences"))); }
    ~PrivatePluginConfigTest() override { Dir::SetPrefDir(Dir()); }

    /// Installs a plug-in of one filter, whose ID is the technology and the name.
    void Install(TechnologyType type, const UTF16String& path, const UTF16String& name)
    {
        std::filesystem::create_directories(ToNativePath(path));
        const UTF16String id = (type == kTechnologyVST ? u"2:" : u"3:") + name;
        mMachine.plugins.push_back({PluginLocator(type, path), true, {{id, false, false, name}}});
    }

    /// The result file's content.
    UTF8String Result() const { return zebcore::utility::FileUtils::SimpleReadStringFromFile(mResult); }

    bool ResultHolds(std::u8string_view text) const { return Result().find(text) != UTF8String::npos; }

    /// The next start of an application, installed elsewhere: nothing is scanned.
    void StartElsewhere(const UTF16String& vst3Directory, const UTF16String& vstDirectory)
    {
        mMachine.log.clear();
        mManager.ClearAll(true);
        utility::SetPrivatePluginConfigFromFile(mResult, vst3Directory, vstDirectory);
        EXPECT_TRUE(CatalogueIDs().empty()) << "nothing is loaded before LoadConfiguration";
        File settings = FileInFolder("no settings.xml");
        mManager.LoadConfiguration(settings);
        EXPECT_TRUE(mMachine.log.empty());
        EXPECT_TRUE(RecordPaths().empty());
    }

    DescriptorPtr Find(const UTF16String& id) const { return mDescriptors.GetComponentDescriptorForID(id); }

    PluginModuleInfoManager& mManager = PluginModuleInfoManager::GetInstance();
    AudioFilterDescriptorManager& mDescriptors = AudioFilterDescriptorManager::GetInstance();
    const UTF16String mResult = PathInFolder("PrivatePluginConfig.txt");
    const UTF16String mVST = PathInFolder("VST");
    const UTF16String mVST3 = PathInFolder("VST3");
};

} // namespace

TEST_F(PrivatePluginConfigTest, NamesAndFoldersSurviveTheMove)
{
    const std::vector<UTF16String> names = {u"plain",
                                            u"my vst and vst3 and .vst3",
                                            u"vstvst3vst",
                                            u"R&D <\"quoted\"> 'and' &amp; &#9; \\u0041",
                                            u"  blanks  \t ",
                                            u"Gr\u00f6\u00dfe \u30d7\u30e9\u30b0\u30a4\u30f3 \U0001f39b",
                                            UTF16String(u"padded\0\0\0", 9),
                                            u"lone \xd800 surrogate"};
    const std::vector<UTF16String> folders = {u"plain",
                                              u"R&D <\"x\"> 'y' &amp;",
                                              u" blanks ",
                                              u"Gr\u00f6\u00dfe \u30d7\u30e9\u30b0\u30a4\u30f3 \U0001f39b",
                                              u"back\\u0041slash",
                                              u"my vst plug-ins",
                                              u"tab\tand\nline"};
    int number = 0;
    for (const UTF16String& folder : folders)
    {
        SCOPED_TRACE(Text(folder));
        mMachine = FakeMachine();
        const UTF16String root = PathInFolder("built" + std::to_string(number++)) + u"/" + folder;
        const UTF16String vst = root + u"/VST";
        const UTF16String vst3 = root + u"/vst3";
        for (std::size_t index = 0; index < names.size(); ++index)
        {
            const UTF16String file = u"/p&vst" + UTF16String(1, static_cast<char16_t>(u'0' + index));
            Install(kTechnologyVST, vst + file + u".vst", names[index]);
            Install(kTechnologyVST3, vst3 + file + u".vst3", names[index]);
        }

        utility::BuildPrivatePluginConfig(mResult, vst, vst3);
        UTF16String escaped;
        zebcore::xml::utils::EncodeReservedCharacters(folder, escaped);
        EXPECT_FALSE(ResultHolds(zebcore::utility::UTF16to8(u"/" + escaped + u"/")));
        EXPECT_FALSE(ResultHolds(u8"vst"));

        const UTF16String elsewhere = u"/opt/vst & vst3/" + folder;
        const UTF16String newVST = elsewhere + u"/2";
        const UTF16String newVST3 = elsewhere + u"/3";
        StartElsewhere(newVST3, newVST);
        EXPECT_EQ(CatalogueIDs().size(), 2 * names.size());
        for (std::size_t index = 0; index < names.size(); ++index)
        {
            SCOPED_TRACE(Text(names[index]));
            const UTF16String file = u"/p&vst" + UTF16String(1, static_cast<char16_t>(u'0' + index));
            const DescriptorPtr ofVST = Find(u"2:" + names[index]);
            const DescriptorPtr ofVST3 = Find(u"3:" + names[index]);
            ASSERT_TRUE(ofVST && ofVST3);
            EXPECT_TRUE(ofVST->GetName() == names[index]);
            EXPECT_TRUE(ofVST3->GetName() == names[index]);
            EXPECT_EQ(Text(ofVST->GetLocator()), Text(VST2(newVST + file + u".vst")));
            EXPECT_EQ(Text(ofVST3->GetLocator()), Text(VST3(newVST3 + file + u".vst3")));
        }
    }
}

TEST_F(PrivatePluginConfigTest, TakesBundlesOfTheFoldersThemselvesInOrder)
{
    for (const UTF16String name : {u"/b.vst3", u"/A.VST3", u"/c.vst3.old", u"/deeper/d.vst3", u"/e.vst", u"/f"})
    {
        Install(kTechnologyVST3, mVST3 + name, name);
    }
    for (const UTF16String name : {u"/b.Vst", u"/a.vst", u"/c.vst3"})
    {
        Install(kTechnologyVST, mVST + name, name);
    }
    zebcore::utility::FileUtils::SimpleWriteStringToFile(mVST3 + u"/file.vst3", u8"");
    BannedPluginManager::GetInstance().AddBannedPlugin(VST3(mVST3 + u"/b.vst3"));

    utility::BuildPrivatePluginConfig(mResult, mVST, mVST3);
    EXPECT_EQ(CatalogueIDs(), (Strings{"2:/a.vst", "2:/b.Vst", "3:/A.VST3", "3:/b.vst3"}));
    EXPECT_EQ(Find(u"3:/b.vst3")->GetCategory(), kCategoryNotQueried);

    // Only the extension in small letters is a placeholder.
    StartElsewhere(u"/3", u"/2");
    EXPECT_EQ(Text(Find(u"3:/A.VST3")->GetLocator()), "3:/3/A.VST3");
    EXPECT_EQ(Text(Find(u"2:/b.Vst")->GetLocator()), "2:/2/b.Vst");
}

TEST_F(PrivatePluginConfigTest, FolderThatIsNotGivenLeavesItsPlaceholdersOut)
{
    struct Case
    {
        bool vst;
        bool vst3;
        Strings ids;
    };
    const std::vector<Case> cases = {{true, true, {"2:vst vst3", "3:vst vst3"}},
                                     {true, false, {"2:vst vst3"}},
                                     {false, true, {"3:vst vst3"}},
                                     {false, false, {}}};
    Install(kTechnologyVST, mVST + u"/a.vst", u"vst vst3");
    Install(kTechnologyVST3, mVST3 + u"/a.vst3", u"vst vst3");
    for (const Case& given : cases)
    {
        SCOPED_TRACE(std::to_string(given.vst) + std::to_string(given.vst3));
        utility::BuildPrivatePluginConfig(mResult, given.vst ? mVST : u"", given.vst3 ? mVST3 : u"");
        EXPECT_EQ(ResultHolds(u8"@PRIVATEAPPLICATIONPLUGINPATH"), given.vst);
        EXPECT_EQ(ResultHolds(u8"@PLUGINEXTENSION"), given.vst);
        EXPECT_EQ(ResultHolds(u8"@VST3PRIVATEAPPLICATIONPLUGINPATH"), given.vst3);
        EXPECT_EQ(ResultHolds(u8"@VST3PLUGINEXTENSION"), given.vst3);
        EXPECT_EQ(ResultHolds(u8"vst"), given.vst3 && !given.vst);
        StartElsewhere(given.vst3 ? u"/3" : u"", given.vst ? u"/2" : u"");
        EXPECT_EQ(CatalogueIDs(), given.ids);
    }
    utility::BuildPrivatePluginConfig(mResult, PathInFolder("missing"), PathInFolder("missing"));
    PropList list;
    ASSERT_TRUE(zebcore::proplist::utils::LoadPropList(mResult, list, false));
    unsigned int version = 0;
    int records = -1;
    list.GetValue(u8"version", version);
    list.GetValue(u8"num_plugin_infos", records);
    EXPECT_EQ(version, 2u);
    EXPECT_EQ(records, 0);
}

TEST_F(PrivatePluginConfigTest, FoldersOfBothKindsKeepApart)
{
    struct Case
    {
        UTF16String vst; // folders of the build, below the test's own
        UTF16String vst3;
        const char* ofVST; // where the VST 2 plug-in is, with "/2" and "/3" as the folders of the installation
    };
    const std::vector<Case> cases = {{u"my vst3/VST", u"my vst3/VST3", "2:/2/a.vst"},
                                     {u"vst3", u"three", "2:/2/a.vst"},
                                     {u"vst", u"vst3", "2:/2/a.vst"},
                                     {u"vst3 & vst3", u"vst3 & vst3/deeper", "2:/2/a.vst"},
                                     {u"vst/vst3/2", u"vst3", "2:/2/a.vst"},
                                     {u"vst3/vst3", u"vst3", "2:/3/vst3/a.vst"},
                                     {u"vst3", u"vst3", "2:/3/a.vst"}};
    int number = 0;
    for (const Case& given : cases)
    {
        SCOPED_TRACE(Text(given.vst) + " and " + Text(given.vst3));
        mMachine = FakeMachine();
        const UTF16String root = PathInFolder("both" + std::to_string(number++)) + u"/";
        Install(kTechnologyVST, root + given.vst + u"/a.vst", u"vst3 in vst");
        Install(kTechnologyVST3, root + given.vst3 + u"/b.vst3", u"vst in vst3");
        utility::BuildPrivatePluginConfig(mResult, root + given.vst, root + given.vst3);
        EXPECT_FALSE(ResultHolds(zebcore::utility::UTF16to8(root))) << "a folder of the machine that built it";
        StartElsewhere(u"/3", u"/2");
        ASSERT_TRUE(Find(u"2:vst3 in vst") && Find(u"3:vst in vst3"));
        EXPECT_EQ(Text(Find(u"2:vst3 in vst")->GetLocator()), given.ofVST);
        EXPECT_EQ(Text(Find(u"3:vst in vst3")->GetLocator()), "3:/3/b.vst3");
    }
}

TEST_F(PrivatePluginConfigTest, BuildGoesOnWithRealPathsAndTheUsersCatalogue)
{
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/users")));
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/users"), u"3:users"));
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/users"), u"3:ours"));
    File settings(Dir::PrefDir(), mManager.GetSettingsFileName());
    mManager.SaveConfiguration(settings, true);
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/unsaved")));
    mDescriptors.AddAudioFilterDescriptor(MakeInternal(u"gain"));
    utility::SetPrivatePluginConfig(u"overwritten", u"", u"");

    Install(kTechnologyVST3, mVST3 + u"/ours.vst3", u"ours");
    utility::BuildPrivatePluginConfig(mResult, u"", mVST3);
    EXPECT_EQ(RecordPaths(), Strings{"/users"});
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "3:ours", "3:users"}));
    EXPECT_EQ(Text(Find(u"3:ours")->GetLocator()), Text(VST3(mVST3 + u"/ours.vst3")));
    EXPECT_FALSE(ResultHolds(u8"users"));
    EXPECT_FALSE(ResultHolds(u8"gain"));

    mManager.ClearAll(false);
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "3:ours"}));
}

TEST_F(PrivatePluginConfigTest, NothingIsWrittenWhenTheBuildFails)
{
    const UTF8String old = u8"the old text";
    WriteFile("PrivatePluginConfig.txt", old);
    Install(kTechnologyVST3, mVST3 + u"/a.vst3", u"a");
    mMachine.plugins.front().filters.front().throws = true;
    EXPECT_THROW(utility::BuildPrivatePluginConfig(mResult, u"", mVST3), std::runtime_error);
    EXPECT_TRUE(Result() == old);
    EXPECT_THROW(utility::BuildPrivatePluginConfig(PathInFolder("no/such/folder/x"), u"", mVST3),
                 zebcore::filesupport::file_exception);
}

TEST_F(PrivatePluginConfigTest, FillsInPlaceholdersWhereverTheyStand)
{
    const UTF16String text = u"@VST3PRIVATEAPPLICATIONPLUGINPATH|@PRIVATEAPPLICATIONPLUGINPATH|@VST3PLUGINEXTENSION|"
                             u"@PLUGINEXTENSION|@PLUGINEXTENSION@PLUGINEXTENSION|@pluginextension";
    AudioFilterDescriptor written(VST3(u"/p"), text, u"V", 1, kCategoryNone, u"3:p", Guid(), false);
    PropList list;
    list.SetValue(u8"num_descriptors", 1);
    written.Write(list.GetOrCreateSubList(u8"descriptor0"));
    UTF8String xml;
    zebcore::proplist::utils::WritePropList(xml, list);
    utility::SetPrivatePluginConfig(zebcore::utility::UTF8to16(xml), u"/3&", u"/<2");
    utility::SetPrivatePluginConfig(u"", u"/ignored", u"/ignored");
    EXPECT_TRUE(CatalogueIDs().empty());
    mManager.ClearAll(false);
    ASSERT_TRUE(Find(u"3:p"));
    EXPECT_EQ(Text(Find(u"3:p")->GetName()), "/3&|/<2|vst3|vst|vstvst|@pluginextension");
}

TEST_F(PrivatePluginConfigTest, FilesWithoutATextChangeNothing)
{
    Install(kTechnologyVST3, mVST3 + u"/a.vst3", u"a");
    utility::BuildPrivatePluginConfig(mResult, u"", mVST3);
    WriteFile("empty", u8"");
    for (const char* const name : {"empty", "missing", "VST3"})
    {
        SCOPED_TRACE(name);
        utility::SetPrivatePluginConfigFromFile(PathInFolder(name), u"/3", u"/2");
        mManager.ClearAll(false);
        EXPECT_EQ(CatalogueIDs(), Strings{"3:a"});
    }
    // A text that is there and damaged is another matter: it replaces the old one by nothing.
    WriteFile("damaged", u8"\xff<<");
    utility::SetPrivatePluginConfigFromFile(PathInFolder("damaged"), u"/3", u"/2");
    mManager.ClearAll(false);
    EXPECT_TRUE(CatalogueIDs().empty());
}

} // namespace zebaudiofilterhost::testing
