#include "host/PluginModuleInfoManager.h"

#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "tests/host/FakeTechnology.h"

#include <boost/signals2/connection.hpp>
#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;

class PluginModuleInfoManagerTest : public FakeTechnologyFixture
{
protected:
    /// How often the records have changed since the last call.
    int Changes() { return std::exchange(mChanges, 0); }

    PluginModuleInfoManager& mManager = PluginModuleInfoManager::GetInstance();

private:
    int mChanges = 0;
    boost::signals2::scoped_connection mConnection =
        mManager.GetPluginInfosChangedSignal().connect([this] { ++mChanges; });
};

} // namespace

TEST_F(PluginModuleInfoManagerTest, TechnologiesStandInOrderAndTheFirstOfATypeStays)
{
    const auto technologies = mManager.GetPluginTechnologies();
    ASSERT_EQ(technologies.size(), 3u);
    EXPECT_EQ(technologies[0]->GetType(), kTechnologyVST);
    EXPECT_EQ(technologies[1]->GetType(), kTechnologyVST3);
    EXPECT_EQ(technologies[2]->GetType(), kTechnologyAudioUnit);
    EXPECT_FALSE(mManager.GetPluginTechnology(kTechnologyVST3)->HasDirectories());
    EXPECT_EQ(mManager.GetPluginTechnology(kTechnologyInternal), nullptr);
}

TEST_F(PluginModuleInfoManagerTest, NewRecordReplacesTheOldOneAtTheEnd)
{
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/b"), false));
    mManager.AddPluginModuleInfo(MakeInfo(VST2(u"/c"), true));
    EXPECT_EQ(Changes(), 2);
    const InfoPtr again = MakeInfo(VST3(u"/b"), true);
    mManager.AddPluginModuleInfo(again);
    EXPECT_EQ(Changes(), 1);
    EXPECT_EQ(RecordPaths(), (Strings{"/c", "/b"}));
    EXPECT_EQ(mManager.FindPluginInfo(VST3(u"/b")), again);
    EXPECT_EQ(mManager.FindPluginInfo(VST2(u"/b")), nullptr);
    EXPECT_EQ(Texts(mManager.GetPluginLocators()), (Strings{"2:/c", "3:/b"}));
}

TEST_F(PluginModuleInfoManagerTest, OrderOfArrivalSurvivesReplacingAndRemovingMany)
{
    const auto locator = [](int index)
    {
        return VST3(u"/" + UTF16String(1, static_cast<char16_t>(u'a' + index)));
    };
    for (const int index : {0, 1, 2, 3, 4, 1, 1, 3, 0, 1, 1, 1, 1})
    {
        mManager.AddPluginModuleInfo(MakeInfo(locator(index), true));
    }
    mManager.RemovePluginLocators({locator(3), locator(3), locator(9)});
    EXPECT_EQ(RecordPaths(), (Strings{"/c", "/e", "/a", "/b"}));
    mManager.AddPluginModuleInfo(MakeInfo(locator(3), true));
    mManager.AddPluginModuleInfo(MakeInfo(locator(2), true));
    EXPECT_EQ(RecordPaths(), (Strings{"/e", "/a", "/b", "/d", "/c"}));
    EXPECT_EQ(Texts(mManager.GetPluginLocators()), (Strings{"3:/a", "3:/b", "3:/c", "3:/d", "3:/e"}));
}

TEST_F(PluginModuleInfoManagerTest, EnabledFlagIsTheRecordsOrTheCallersDefault)
{
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/on"), true));
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/off"), false));
    Changes();
    EXPECT_TRUE(mManager.IsPluginEnabled(VST3(u"/on"), true));
    EXPECT_FALSE(mManager.IsPluginEnabled(VST3(u"/off"), false));
    EXPECT_TRUE(mManager.IsPluginEnabled(VST3(u"/unknown"), false));
    EXPECT_FALSE(mManager.IsPluginEnabled(VST3(u"/unknown"), true));
    mManager.SetPluginEnabled(VST3(u"/off"), true);
    mManager.SetPluginEnabled(VST3(u"/unknown"), true);
    EXPECT_EQ(Texts(mManager.GetEnabledPlugins()), (Strings{"3:/off", "3:/on"}));
    EXPECT_EQ(Changes(), 0);
}

TEST_F(PluginModuleInfoManagerTest, CollectsNewOnesAndTellsVanishedOnes)
{
    mMachine.plugins = {
        {VST3(u"/z")}, {VST2(u"/vst/b")}, {VST2(u"/elsewhere/c")}, {VST2(u"/vst/a")}, {AudioUnit(u"u")}};
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/z"), true));
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/gone"), true));
    mManager.AddPluginModuleInfo(MakeInfo(VST2(u"/gone"), true));
    std::vector<PluginLocator> removed = {VST3(u"/old content")};
    EXPECT_EQ(Texts(mManager.CollectPotentialPlugins(true, removed)), (Strings{"2:/vst/b", "2:/vst/a", "4:u"}));
    EXPECT_EQ(Texts(removed), (Strings{"2:/gone", "3:/gone"}));
    EXPECT_EQ(Texts(mManager.CollectPotentialPlugins(false, removed)),
              (Strings{"2:/vst/b", "2:/vst/a", "3:/z", "4:u"}));
    EXPECT_EQ(Texts(removed), (Strings{"2:/gone", "3:/gone"}));

    BannedPluginManager::GetInstance().AddBannedPlugin(VST3(u"/z"));
    EXPECT_EQ(Texts(mManager.CollectPotentialPlugins(false, removed)), (Strings{"2:/vst/b", "2:/vst/a", "4:u"}));
    EXPECT_EQ(Texts(removed), (Strings{"2:/gone", "3:/gone", "3:/z"}));
}

TEST_F(PluginModuleInfoManagerTest, NestedDirectoriesGiveAPluginTwice)
{
    mMachine.plugins = {{VST2(u"/vst/deep/a")}};
    mManager.GetPluginTechnology(kTechnologyVST)->AddPluginDirectories({u"/vst/deep"});
    std::vector<PluginLocator> removed;
    EXPECT_EQ(Texts(mManager.CollectPotentialPlugins(true, removed)), (Strings{"2:/vst/deep/a", "2:/vst/deep/a"}));
}

TEST_F(PluginModuleInfoManagerTest, RemovingTakesRecordsWithTheirDescriptors)
{
    AudioFilterDescriptorManager& descriptors = AudioFilterDescriptorManager::GetInstance();
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/a")));
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/b")));
    mManager.AddPluginModuleInfo(MakeInfo(VST3(u"/c")));
    for (const UTF16String path : {u"/a", u"/a", u"/b", u"/no record"})
    {
        descriptors.AddAudioFilterDescriptor(MakeExternal(VST3(path), u"3:" + path));
    }
    Changes();
    mManager.RemovePluginLocators({});
    mManager.RemovePluginLocators({VST3(u"/no record"), VST2(u"/a")});
    EXPECT_EQ(Changes(), 0);
    mManager.RemovePluginLocators({VST3(u"/c"), VST3(u"/a"), VST3(u"/a"), VST3(u"/no record")});
    EXPECT_EQ(Changes(), 1);
    EXPECT_EQ(RecordPaths(), Strings{"/b"});
    EXPECT_EQ(Texts(mManager.GetPluginLocators()), Strings{"3:/b"});
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:/b", "3:/no record"}));
}

TEST_F(PluginModuleInfoManagerTest, DisplayStringFallsBackToThePath)
{
    EXPECT_EQ(Text(mManager.GetDisplayStringForLocator(VST3(u"/a"))), "Shown /a");
    EXPECT_EQ(Text(mManager.GetDisplayStringForLocator(VST3(u"/nameless"))), "/nameless");
    EXPECT_EQ(Text(mManager.GetDisplayStringForLocator({kTechnologyInternal, u"/a"})), "/a");
}

TEST_F(PluginModuleInfoManagerTest, FileNameCanBeChanged)
{
    const UTF16String standard = mManager.GetSettingsFileName();
    EXPECT_EQ(Text(standard), "AudioPluginManagerSettings.xml");
    mManager.SetSettingsFileName(u"Other.xml");
    EXPECT_EQ(Text(mManager.GetSettingsFileName()), "Other.xml");
    mManager.SetSettingsFileName(standard);
}

} // namespace zebaudiofilterhost::testing
