#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/internal/FileSystemCalls.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "tests/host/FakeTechnology.h"

#include <boost/signals2/connection.hpp>
#include <gtest/gtest.h>

#include <cerrno>
#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;

class ConfigurationTest : public FakeTechnologyFixture
{
protected:
    Strings Directories(TechnologyType type) const
    {
        const auto technology = mManager.GetPluginTechnology(type);
        Strings directories;
        for (auto directory = technology->DirectoryBegin(); directory != technology->DirectoryEnd(); ++directory)
        {
            directories.push_back(Text(*directory));
        }
        return directories;
    }

    void Load(const PropList& list)
    {
        File file = FileInFolder("settings.xml");
        zebcore::proplist::utils::SavePropList(file, list);
        mManager.LoadConfiguration(file);
    }

    /// How often the records have changed since the last call.
    int Changes() { return std::exchange(mChanges, 0); }

    PluginModuleInfoManager& mManager = PluginModuleInfoManager::GetInstance();
    AudioFilterDescriptorManager& mDescriptors = AudioFilterDescriptorManager::GetInstance();

private:
    int mChanges = 0;
    boost::signals2::scoped_connection mConnection =
        mManager.GetPluginInfosChangedSignal().connect([this] { ++mChanges; });
};

void PutRecord(PropList& list, const UTF8String& key, const PluginLocator& locator, const UTF16String& name = u"N")
{
    PluginModuleInfo(locator, name, u"V", 1, locator.GetTechnologyType(), true, false)
        .Write(list.GetOrCreateSubList(key));
}

/// While it lives, no file can be moved over another.
class FailingRename
{
public:
    explicit FailingRename(int error)
    {
        zebcore::filesupport::FileSystem().mRename = [error](const char*, const char*)
        {
            errno = error;
            return -1;
        };
    }
    ~FailingRename() { zebcore::filesupport::FileSystem() = {}; }

    FailingRename(const FailingRename&) = delete;
    FailingRename& operator=(const FailingRename&) = delete;
};

UTF8String DescriptorsAsText(const std::vector<DescriptorPtr>& descriptors)
{
    PropList list;
    list.SetValue(u8"num_descriptors", static_cast<int>(descriptors.size()));
    UTF8String key = u8"descriptor0";
    for (const DescriptorPtr& descriptor : descriptors)
    {
        descriptor->Write(list.GetOrCreateSubList(key));
        ++key.back();
    }
    UTF8String text;
    zebcore::proplist::utils::WritePropList(text, list);
    return text;
}

PropList VersionedList(unsigned int version)
{
    PropList list;
    list.SetValue(u8"version", version);
    return list;
}

} // namespace

TEST_F(ConfigurationTest, RecordSectionKeepsOrderTypesAndEveryField)
{
    PluginModuleInfo written(VST3(u"/p:q"), UTF16String(u"N\0\0\xd800", 4), u"V\u0001", 4294967295u, kTechnologyVST3,
                             true, true);
    EXPECT_FALSE(written.HasAnyNonSynthEffect());
    PropList list;
    written.Write(list);
    EXPECT_EQ(Layout(list), (Strings{"locator text", "name text", "vendor text", "version unsigned", "type int",
                                     "enabled bool", "isShell bool", "hasNonSynth bool"}));
    PluginModuleInfo read(list);
    EXPECT_TRUE(read.GetLocator() == written.GetLocator());
    EXPECT_TRUE(read.GetName() == written.GetName());
    EXPECT_TRUE(read.GetVendor() == written.GetVendor());
    EXPECT_EQ(read.GetVersion(), 4294967295u);
    EXPECT_EQ(read.GetType(), kTechnologyVST3);
    EXPECT_TRUE(read.IsEnabled());
    EXPECT_TRUE(read.IsShell());
    EXPECT_FALSE(read.HasAnyNonSynthEffect());

    read.Read(PropList());
    EXPECT_EQ(Text(read.GetLocator()), "0:");
    EXPECT_EQ(read.GetType(), kTechnologyNone);
    EXPECT_TRUE(read.GetName() == written.GetName());
    EXPECT_TRUE(read.IsEnabled());

    const PluginModuleInfo empty{PropList()};
    EXPECT_FALSE(empty.IsEnabled());
    EXPECT_TRUE(empty.HasAnyNonSynthEffect());
}

TEST_F(ConfigurationTest, SurvivesTheFileBitForBit)
{
    const UTF16String padded(u"Name\0\0\0", 7);
    const UTF16String broken = u"\xd800 \x0001 \xdc00 <&>\"\r\n\t ";
    mManager.AddPluginModuleInfo(
        new PluginModuleInfo(VST3(u"/b\u00e9"), padded, broken, 1, kTechnologyVST3, true, true));
    mManager.AddPluginModuleInfo(MakeInfo(VST2(u"/a"), false));
    mDescriptors.AddAudioFilterDescriptor(MakeInternal(u"gain"));
    mDescriptors.AddAudioFilterDescriptor(new AudioFilterDescriptor(VST3(u"/b\u00e9"), padded, broken, 1,
                                                                    kCategoryNone, u"3:" + broken, Guid(), false));
    mManager.GetPluginTechnology(kTechnologyVST)->AddPluginDirectories({u"/second", u" blanks "});
    const UTF8String before = mManager.GetConfigurationAsXML();
    File file = FileInFolder("settings.xml");
    mManager.SaveConfiguration(file, true);

    mManager.ClearAll(true);
    EXPECT_EQ(CatalogueIDs(), Strings{"gain"});
    EXPECT_TRUE(RecordPaths().empty());
    mManager.GetPluginTechnology(kTechnologyVST)->RemoveAllPluginDirectories();
    Changes();
    mManager.LoadConfiguration(file);
    EXPECT_EQ(Changes(), 1);
    EXPECT_TRUE(mManager.GetConfigurationAsXML() == before);
    EXPECT_EQ(RecordPaths(), (Strings{"/b\xc3\xa9", "/a"}));
    EXPECT_TRUE(mManager.FindPluginInfo(VST3(u"/b\u00e9"))->GetName() == padded);
    EXPECT_TRUE(mManager.FindPluginInfo(VST3(u"/b\u00e9"))->GetVendor() == broken);
    ASSERT_TRUE(mDescriptors.GetComponentDescriptorForID(u"3:" + broken));
    EXPECT_TRUE(mDescriptors.GetComponentDescriptorForID(u"3:" + broken)->GetName() == padded);
    EXPECT_EQ(Directories(kTechnologyVST), (Strings{"/vst", "/second", " blanks "}));
}

TEST_F(ConfigurationTest, LayoutOfTheFile)
{
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/a")));
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:a"));
    PropList whole;
    mManager.BuildConfigurationPropList(whole, true);
    EXPECT_EQ(Layout(whole), (Strings{"version unsigned", "num_tech_infos int", "tech_info0 list", "tech_info1 list",
                                      "tech_info2 list", "num_plugin_infos int", "plugin_info0 list",
                                      "num_descriptors int", "descriptor0 list"}));
    const PropList* const technology = whole.GetSubList(u8"tech_info0");
    ASSERT_NE(technology, nullptr);
    EXPECT_EQ(Layout(*technology), (Strings{"tech_type int", "num_directories int", "directories0 text"}));
    unsigned int version = 0;
    EXPECT_TRUE(whole.GetValue(u8"version", version));
    EXPECT_EQ(version, 2u);

    PropList withoutDirectories;
    mManager.BuildConfigurationPropList(withoutDirectories, false);
    EXPECT_EQ(Layout(withoutDirectories), (Strings{"version unsigned", "num_plugin_infos int", "plugin_info0 list",
                                                   "num_descriptors int", "descriptor0 list"}));
}

TEST_F(ConfigurationTest, FileAndTextHoldTheListOfTheConfiguration)
{
    for (const UTF16String path : {u"/a", u"/b", u"/c"})
    {
        mManager.AddPluginModuleInfo(MakeInfo(VST3(path)));
        mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(path), u"3:" + path));
    }
    for (const bool withDirectories : {false, true})
    {
        PropList list;
        mManager.BuildConfigurationPropList(list, withDirectories);
        UTF8String expected;
        zebcore::proplist::utils::WritePropList(expected, list);
        File file = FileInFolder("settings.xml");
        mManager.SaveConfiguration(file, withDirectories);
        EXPECT_TRUE(zebcore::utility::FileUtils::SimpleReadStringFromFile(file.FullPath()) == expected);
        EXPECT_EQ(mManager.GetConfigurationAsXML() == expected, withDirectories);
    }
}

TEST_F(ConfigurationTest, FileWithoutDirectoriesLeavesThem)
{
    File file = FileInFolder("settings.xml");
    mManager.SaveConfiguration(file, false);
    mManager.GetPluginTechnology(kTechnologyVST)->AddPluginDirectories({u"/more"});
    mManager.LoadConfiguration(file);
    EXPECT_EQ(Directories(kTechnologyVST), (Strings{"/vst", "/more"}));
}

TEST_F(ConfigurationTest, OtherVersionsAndMissingFilesCountAsNone)
{
    for (const unsigned int version : {0u, 1u, 3u})
    {
        SCOPED_TRACE(version);
        PropList list = VersionedList(version);
        list.SetValue(u8"num_plugin_infos", 1);
        PutRecord(list, u8"plugin_info0", VST3(u"/a"));
        mManager.GetPluginTechnology(kTechnologyVST)->AddPluginDirectories({u"/mine"});
        Load(list);
        EXPECT_TRUE(RecordPaths().empty());
        EXPECT_EQ(Directories(kTechnologyVST), Strings{"/std"});
        EXPECT_EQ(Changes(), 1);
    }
    mManager.GetPluginTechnology(kTechnologyVST)->AddPluginDirectories({u"/mine"});
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/known")));
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/known"), u"3:known"));
    Changes();
    File missing = FileInFolder("missing.xml");
    mManager.LoadConfiguration(missing);
    EXPECT_EQ(Directories(kTechnologyVST), (Strings{"/std", "/mine"})) << "directories stay while there are records";
    EXPECT_EQ(RecordPaths(), Strings{"/known"});
    EXPECT_TRUE(CatalogueIDs().empty());
    EXPECT_EQ(Changes(), 1);
}

TEST_F(ConfigurationTest, DamagedFileCountsAsNone)
{
    for (const std::u8string_view text : {u8"", u8"<", u8"not XML", u8"<?xml version=\"1.0\"?><a><b></a>"})
    {
        File file = WriteFile("damaged.xml", text);
        mManager.LoadConfiguration(file);
        EXPECT_TRUE(RecordPaths().empty());
        EXPECT_EQ(Directories(kTechnologyVST), Strings{"/std"});
    }
}

TEST_F(ConfigurationTest, ReadsRecordsWhateverTheCountSays)
{
    struct Case
    {
        int count;
        Strings paths;
    };
    const std::vector<Case> cases = {
        {3, {"/zero", "/two"}}, {2147483647, {"/zero", "/two", "/far"}}, {1, {"/zero"}}, {0, {}}, {-5, {}}};
    for (const Case& expected : cases)
    {
        SCOPED_TRACE(expected.count);
        PropList list = VersionedList(2);
        list.SetValue(u8"num_plugin_infos", expected.count);
        PutRecord(list, u8"plugin_info1000000", VST3(u"/far"));
        PutRecord(list, u8"plugin_info2", VST3(u"/two"));
        PutRecord(list, u8"plugin_info0", VST3(u"/zero"));
        Load(list);
        EXPECT_EQ(RecordPaths(), expected.paths);
    }
}

TEST_F(ConfigurationTest, LaterSectionOfALocatorWins)
{
    PropList list = VersionedList(2);
    list.SetValue(u8"num_plugin_infos", 4);
    PutRecord(list, u8"plugin_info0", VST3(u"/a"), u"first");
    PutRecord(list, u8"plugin_info1", VST3(u"/b"));
    PutRecord(list, u8"plugin_info2", VST3(u"/a"), u"second");
    PutRecord(list, u8"plugin_info3", VST3(u"/a"), u"third");
    Load(list);
    EXPECT_EQ(RecordPaths(), (Strings{"/b", "/a"}));
    EXPECT_EQ(Text(mManager.FindPluginInfo(VST3(u"/a"))->GetName()), "third");

    PluginModuleInfoManager::PluginInfoMap infos;
    PluginModuleInfoManager::PluginInfoVector order;
    mManager.ReadPluginInfos(list, infos, order, true);
    mManager.ReadPluginInfos(list, infos, order, true);
    EXPECT_EQ(infos.size(), 2u);
    ASSERT_EQ(order.size(), 2u);
    EXPECT_EQ(order[1], infos[VST3(u"/a")]);
    mManager.ReadPluginInfos(PropList(), infos, order, true);
    EXPECT_EQ(order.size(), 2u);
    // The containers may differ: what the map has replaces the first of its locator in the vector, whichever that is.
    const InfoPtr other = MakeInfo(VST3(u"/a"));
    order = {other, order[1]};
    mManager.ReadPluginInfos(list, infos, order, true);
    EXPECT_EQ(std::count(order.begin(), order.end(), other), 0);
    EXPECT_EQ(order.back(), infos[VST3(u"/a")]);
    mManager.ReadPluginInfos(PropList(), infos, order, false);
    EXPECT_TRUE(infos.empty() && order.empty());
}

TEST_F(ConfigurationTest, DirectoriesOfUnknownTechnologiesAndEmptyOnesAreSkipped)
{
    PropList list = VersionedList(2);
    list.SetValue(u8"num_tech_infos", 2147483647);
    PropList& unknown = list.GetOrCreateSubList(u8"tech_info0");
    unknown.SetValue(u8"tech_type", 99);
    unknown.SetValue(u8"num_directories", 1);
    unknown.SetValue(u8"directories0", u"/unknown");
    PropList& untyped = list.GetOrCreateSubList(u8"tech_info1");
    untyped.SetValue(u8"num_directories", 1);
    PropList& vst = list.GetOrCreateSubList(u8"tech_info5");
    vst.SetValue(u8"tech_type", 2);
    vst.SetValue(u8"num_directories", 2147483647);
    vst.SetValue(u8"directories0", u"/one");
    vst.SetValue(u8"directories00", u"/not the way we count");
    vst.SetValue(u8"directories1", u"");
    vst.SetValue(u8"directories7", u"/seven");
    mManager.ReadDirectories(list);
    EXPECT_EQ(Directories(kTechnologyVST), (Strings{"/one", "/seven"}));

    vst.SetValue(u8"num_directories", 0);
    mManager.ReadDirectories(list);
    EXPECT_TRUE(Directories(kTechnologyVST).empty());
}

TEST_F(ConfigurationTest, PrivateDescriptorsWinOverTheFiles)
{
    const DescriptorPtr ours =
        new AudioFilterDescriptor(VST3(u"/private"), u"private", u"V", 1, kCategoryNone, u"3:both", Guid(), false);
    mManager.SetPrivatePluginConfiguration(u8"overwritten");
    mManager.SetPrivatePluginConfiguration(DescriptorsAsText({ours, MakeExternal(VST3(u"/private"), u"3:private")}));
    EXPECT_TRUE(CatalogueIDs().empty());
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/file"), u"3:file"));
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/file"), u"3:both"));
    File file = FileInFolder("settings.xml");
    mManager.SaveConfiguration(file, true);

    mManager.LoadConfiguration(file);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:both", "3:private", "3:file"}));
    EXPECT_EQ(Text(mDescriptors.GetComponentDescriptorForID(u"3:both")->GetName()), "private");

    Changes();
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/file")));
    mManager.ClearAll(false);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:both", "3:private"}));
    mDescriptors.AddAudioFilterDescriptor(MakeInternal(u"gain"));
    mManager.ClearAll(true);
    EXPECT_EQ(CatalogueIDs(), Strings{"gain"});
    EXPECT_TRUE(RecordPaths().empty());
    EXPECT_EQ(Changes(), 1) << "clearing is silent";

    File missing = FileInFolder("missing.xml");
    mManager.LoadConfiguration(missing);
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "3:both", "3:private"}));
}

TEST_F(ConfigurationTest, AddingMergesRecordsByTheLaterAndDescriptorsByTheEarlier)
{
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/a"), false));
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/b")));
    mDescriptors.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:a"));
    PropList added = VersionedList(99);
    added.SetValue(u8"num_plugin_infos", 1);
    PutRecord(added, u8"plugin_info0", VST3(u"/a"));
    added.SetValue(u8"num_tech_infos", 1);
    PropList& vst = added.GetOrCreateSubList(u8"tech_info0");
    vst.SetValue(u8"tech_type", 2);
    added.SetValue(u8"num_descriptors", 2);
    MakeExternal(VST3(u"/other"), u"3:a")->Write(added.GetOrCreateSubList(u8"descriptor0"));
    MakeExternal(VST3(u"/other"), u"3:new")->Write(added.GetOrCreateSubList(u8"descriptor1"));
    UTF8String text;
    zebcore::proplist::utils::WritePropList(text, added);
    Changes();

    mManager.AddConfiguration(text, false);
    EXPECT_EQ(Changes(), 0);
    EXPECT_EQ(RecordPaths(), (Strings{"/b", "/a"}));
    EXPECT_TRUE(mManager.IsPluginEnabled(VST3(u"/a"), true));
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:a", "3:new"}));
    EXPECT_EQ(Text(mDescriptors.GetComponentDescriptorForID(u"3:a")->GetLocator()), "3:/a");
    EXPECT_EQ(Directories(kTechnologyVST), Strings{"/vst"});

    mManager.AddConfiguration(u8"broken <", true);
    EXPECT_EQ(Changes(), 1);
    EXPECT_EQ(RecordPaths(), (Strings{"/b", "/a"}));
}

TEST_F(ConfigurationTest, FileThatTheSystemKeepsEndsTheSaveSilentlyAndStays)
{
    File file = FileInFolder("settings.xml");
    mManager.SaveConfiguration(file, true);
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/a")));
    {
        const FailingRename refused(EPERM);
        EXPECT_NO_THROW(mManager.SaveConfiguration(file, true));
        EXPECT_THROW(BannedPluginManager::GetInstance().SaveConfiguration(file),
                     zebcore::filesupport::file_delete_exception);
    }
    {
        const FailingRename full(ENOSPC);
        EXPECT_THROW(mManager.SaveConfiguration(file, true), zebcore::filesupport::file_exception);
    }
    File nowhere = FileInFolder("no/such/folder/settings.xml");
    EXPECT_THROW(mManager.SaveConfiguration(nowhere, true), zebcore::filesupport::file_exception);
    mManager.LoadConfiguration(file);
    EXPECT_TRUE(RecordPaths().empty());
}

TEST_F(ConfigurationTest, ResetReachesEveryTechnology)
{
    int resets = 0;
    std::vector<boost::signals2::scoped_connection> connections;
    for (const auto& technology : mManager.GetPluginTechnologies())
    {
        connections.emplace_back(technology->GetDirectoriesChangedSignal().connect(
            [&resets](const auto&, const auto& added, const auto&) { resets += added.empty() ? 1 : 0; }));
    }
    mManager.ResetToDefaultFolders();
    EXPECT_EQ(resets, 3);
    EXPECT_EQ(Directories(kTechnologyVST), Strings{"/std"});
    EXPECT_TRUE(Directories(kTechnologyVST3).empty());
}

} // namespace zebaudiofilterhost::testing
