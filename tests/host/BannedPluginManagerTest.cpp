#include "host/BannedPluginManager.h"

#include "foundation/zebcore/PropListUtils.h"
#include "host/src/UnsupportedVSTParseHandler.h"
#include "tests/host/CatalogueFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;

class BannedPluginManagerTest : public CatalogueFixture
{
protected:
    ~BannedPluginManagerTest() override { LoadPermanent(u8"<pluginlist/>"); }

    Strings Banned() const { return Texts(std::vector<PluginLocator>(mManager.BannedBegin(), mManager.BannedEnd())); }

    void Load(const PropList& list)
    {
        File file = FileInFolder("dynamic.xml");
        zebcore::proplist::utils::SavePropList(file, list);
        mManager.LoadConfiguration(file);
    }

    bool LoadPermanent(std::u8string_view text)
    {
        File file = WriteFile("permanent.xml", text);
        return mManager.LoadStaticConfiguration(file);
    }

    BannedPluginManager& mManager = BannedPluginManager::GetInstance();
};

} // namespace

TEST_F(BannedPluginManagerTest, DynamicListIsASetInLocatorOrder)
{
    mManager.AddBannedPlugin(VST3(u"/b"));
    mManager.AddBannedPlugin(VST3(u"/b"));
    mManager.AddBannedPlugin(AudioUnit(u"a"));
    mManager.AddBannedPlugin(VST2(u"/z"));
    EXPECT_EQ(Banned(), (Strings{"2:/z", "3:/b", "4:a"}));
    EXPECT_TRUE(mManager.IsPluginBanned(VST3(u"/b")));
    EXPECT_FALSE(mManager.IsPluginBanned(VST2(u"/b")));
    mManager.RemoveBannedPlugin(VST3(u"/b"));
    mManager.RemoveBannedPlugin(VST3(u"/unknown"));
    EXPECT_EQ(Banned(), (Strings{"2:/z", "4:a"}));
}

TEST_F(BannedPluginManagerTest, DynamicFileReplacesTheList)
{
    mManager.AddBannedPlugin(VST3(UTF16String(u"/b\0\xd800", 4)));
    mManager.AddBannedPlugin(VST2(u"/a:b"));
    File file = FileInFolder("dynamic.xml");
    mManager.SaveConfiguration(file);
    PropList list;
    ASSERT_TRUE(zebcore::proplist::utils::LoadPropList(file.FullPath(), list, false));
    EXPECT_EQ(Layout(list), (Strings{"version unsigned", "num_banned_plugin_files int", "banned_plugin_files0 text",
                                     "banned_plugin_files1 text"}));

    mManager.AddBannedPlugin(VST3(u"/later"));
    mManager.LoadConfiguration(file);
    EXPECT_TRUE(mManager.IsPluginBanned(VST3(UTF16String(u"/b\0\xd800", 4))));
    EXPECT_TRUE(mManager.IsPluginBanned(VST2(u"/a:b")));
    EXPECT_EQ(Banned().size(), 2u);
}

TEST_F(BannedPluginManagerTest, OtherVersionsAndMissingFilesChangeNothing)
{
    mManager.AddBannedPlugin(VST3(u"/kept"));
    PropList list;
    list.SetValue(u8"num_banned_plugin_files", 1);
    list.SetValue(u8"banned_plugin_files0", u"3:/file");
    Load(list);
    list.SetValue(u8"version", 2u);
    Load(list);
    File missing = FileInFolder("missing.xml");
    mManager.LoadConfiguration(missing);
    File damaged = WriteFile("damaged.xml", u8"<<");
    mManager.LoadConfiguration(damaged);
    EXPECT_EQ(Banned(), Strings{"3:/kept"});
    list.SetValue(u8"version", 1u);
    Load(list);
    EXPECT_EQ(Banned(), Strings{"3:/file"});
}

TEST_F(BannedPluginManagerTest, EmptyEntriesAreSkippedAndCountsMayLie)
{
    PropList list;
    list.SetValue(u8"num_banned_plugin_files", 2147483647);
    list.SetValue(u8"banned_plugin_files0", u"");
    list.SetValue(u8"banned_plugin_files1", u"3:/one");
    list.SetValue(u8"banned_plugin_files2000000000", u"no colon");
    mManager.ReadBannedPlugins(list);
    EXPECT_EQ(Banned(), (Strings{"0:", "3:/one"}));
    list.SetValue(u8"num_banned_plugin_files", -1);
    mManager.ReadBannedPlugins(list);
    EXPECT_TRUE(Banned().empty());
}

TEST_F(BannedPluginManagerTest, PermanentListMatchesNameIDAndVersion)
{
    ASSERT_TRUE(LoadPermanent(u8R"(<?xml version="1.0" encoding="UTF-8"?>
        <pluginlist>
            <note>read over</note>
            <plugin uniqueid="1" version="1"/>
            <plugin filename="" uniqueid="7"/>
            <plugin filename="Any.vst3"/>
            <group><plugin filename="Deep.vst"/></group>
            <plugin filename="Some.vst" uniqueid="42"/>
            <plugin filename="Some.vst" version="3"/>
            <plugin filename="Both.vst" uniqueid="aB" version="1"/>
            <Plugin filename="Capital.vst"/>
            <plugin Filename="Attribute.vst"/>
            <plugin filename="&#xC9;t&#xE9;.vst"/>
        </pluginlist>)"));
    struct Case
    {
        UTF16String fileName;
        UTF16String uniqueID;
        UTF16String version;
        bool banned;
    };
    const std::vector<Case> cases = {
        {u"Any.vst3", u"none", u"0", true},
        {u"aNY.VST3", u"", u"", true},
        {u"Any.vst", u"none", u"0", false},
        {u"Any.vst33", u"none", u"0", false},
        {u"", u"1", u"1", false},
        {u"", u"7", u"", false},
        {u"Deep.vst", u"1", u"1", true},
        {u"Some.vst", u"42", u"1", true},
        {u"Some.vst", u"41", u"3", true},
        {u"Some.vst", u"41", u"2", false},
        {u"Both.vst", u"Ab", u"1", true},
        {u"Both.vst", u"ab", u"2", false},
        {u"Both.vst", u"", u"1", false},
        {u"Capital.vst", u"", u"", false},
        {u"Attribute.vst", u"", u"", false},
        {u"\u00c9t\u00e9.VST", u"", u"", true},
        {u"\u00e9t\u00e9.vst", u"", u"", false},
    };
    for (const Case& expected : cases)
    {
        EXPECT_EQ(mManager.IsPluginBannedStatically(expected.fileName, expected.uniqueID, expected.version),
                  expected.banned)
            << Text(expected.fileName) << " " << Text(expected.uniqueID) << " " << Text(expected.version);
    }
}

TEST_F(BannedPluginManagerTest, BrokenPermanentFileKeepsTheOldEntries)
{
    ASSERT_TRUE(LoadPermanent(u8"<pluginlist><plugin filename='Old.vst'/></pluginlist>"));
    EXPECT_FALSE(LoadPermanent(u8"<pluginlist><plugin filename='New.vst'/></wrong>"));
    EXPECT_FALSE(LoadPermanent(u8""));
    File missing = FileInFolder("missing.xml");
    EXPECT_FALSE(mManager.LoadStaticConfiguration(missing));
    EXPECT_TRUE(mManager.IsPluginBannedStatically(u"Old.vst", u"", u""));
    EXPECT_FALSE(mManager.IsPluginBannedStatically(u"New.vst", u"", u""));
    EXPECT_TRUE(LoadPermanent(u8"<pluginlist/>"));
    EXPECT_FALSE(mManager.IsPluginBannedStatically(u"Old.vst", u"", u""));
}

TEST(UnsupportedVSTParseHandler, UnknownElementsDoNotExhaustItsStack)
{
    std::vector<StaticBanEntry> entries;
    UnsupportedVSTParseHandler handler(entries);
    for (int element = 0; element < 100; ++element)
    {
        handler.StartElement(u"unknown", {});
        handler.EndElement(u"unknown");
    }
    handler.StartElement(u"plugin", {{u"filename", u"A"}, {u"version", u"2"}});
    handler.EndElement(u"plugin");
    ASSERT_EQ(entries.size(), 1u);
    EXPECT_EQ(Text(entries[0].fileName) + Text(entries[0].uniqueID) + Text(entries[0].version), "A2");
}

TEST_F(BannedPluginManagerTest, FileNamesCanBeChanged)
{
    EXPECT_EQ(Text(mManager.GetSettingsFileName()), "DynamicAudioPlugInBlacklist.xml");
    EXPECT_EQ(Text(mManager.GetPermanentBannedSettingsFileName()), "PermanentAudioPlugInBlacklist.xml");
    mManager.SetSettingsFileName(u"d.xml");
    mManager.SetPermanentBannedSettingsFileName(u"p.xml");
    EXPECT_EQ(Text(mManager.GetSettingsFileName()) + Text(mManager.GetPermanentBannedSettingsFileName()),
              "d.xmlp.xml");
    mManager.SetSettingsFileName(u"DynamicAudioPlugInBlacklist.xml");
    mManager.SetPermanentBannedSettingsFileName(u"PermanentAudioPlugInBlacklist.xml");
}

} // namespace zebaudiofilterhost::testing
