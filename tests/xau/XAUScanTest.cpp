#include "foundation/zebcore/DebugDatabase.h"
#include "host/AudioFilterDescriptor.h"
#include "host/AudioFilterFactory.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "host/src/XAU/src/XAUPluginSearch.h"
#include "host/src/XAU/src/XAUScanContext.h"
#include "tests/persistence/TempFolder.h"
#include "tests/support/VariableGuard.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gmock/gmock.h>

#include <algorithm>

namespace zebaudiofilterhost::xau
{
namespace
{

constexpr OSType kSystem = 0x6170706C;

class XAUScanTest : public testing::Test
{
protected:
    static PluginLocator LocatorOf(const FakeUnit& unit) { return {kTechnologyAudioUnit, unit.GetID()}; }
    static long CountOffered(const FakeUnit& unit)
    {
        const std::vector<PluginLocator> locators = GetPotentialPluginLocators();
        return std::count(locators.begin(), locators.end(), LocatorOf(unit));
    }

    TempFolder mFolder;
    zebtest::VariableGuard mPath{"AUDIO_COMPONENT_PATH", mFolder.Path().string()};
    TestClock mClock;
};

TEST_F(XAUScanTest, OffersEffectsAndTheSystemsOnlyWhereTheyAreSome)
{
    for (const auto& [type, count] : std::map<OSType, long>{{kAudioUnitType_Effect, 1},
                                                            {kAudioUnitType_MusicEffect, 1},
                                                            {kAudioUnitType_Panner, 1},
                                                            {kAudioUnitType_Mixer, 2},
                                                            {kAudioUnitType_Generator, 0},
                                                            {kAudioUnitType_MusicDevice, 0},
                                                            {kAudioUnitType_OfflineEffect, 0}})
        EXPECT_EQ(CountOffered(FakeUnit(type)), count) << type;
    for (const auto& [type, count] : std::map<OSType, long>{{kAudioUnitType_Effect, 1},
                                                            {kAudioUnitType_MusicEffect, 1},
                                                            {kAudioUnitType_Panner, 0},
                                                            {kAudioUnitType_Mixer, 0}})
        EXPECT_EQ(CountOffered(FakeUnit(type, "System: Unit", kSystem)), count) << type;
    const FakeUnit offline(kAudioUnitType_OfflineEffect, "System: Unit", kSystem);
    EXPECT_EQ(FindComponents(offline.GetDescription()).size(), 1U);
}

TEST_F(XAUScanTest, MixersStandFirstAndLast)
{
    const FakeUnit effect;
    const FakeUnit panner(kAudioUnitType_Panner);
    const FakeUnit music(kAudioUnitType_MusicEffect);
    const FakeUnit mixer(kAudioUnitType_Mixer);
    std::vector<PluginLocator> order;
    for (const PluginLocator& locator : GetPotentialPluginLocators())
    {
        for (const FakeUnit* unit : {&effect, &panner, &music, &mixer})
        {
            if (locator == LocatorOf(*unit))
                order.push_back(locator);
        }
    }
    EXPECT_TRUE(order == (std::vector<PluginLocator>{LocatorOf(mixer), LocatorOf(music), LocatorOf(effect),
                                                     LocatorOf(mixer), LocatorOf(panner)}));
}

TEST_F(XAUScanTest, BlockedUnitsAndAllWithoutSupportAreLeftOut)
{
    const FakeUnit unit;
    BannedPluginManager::GetInstance().AddBannedPlugin(LocatorOf(unit));
    EXPECT_EQ(CountOffered(unit), 0);
    BannedPluginManager::GetInstance().RemoveBannedPlugin(LocatorOf(unit));
    EXPECT_EQ(CountOffered(unit), 1);
    zebcore::debug::DebugDatabase::Instance().SetEntry(u8"EnableAUSupport", u8"false");
    EXPECT_EQ(CountOffered(unit), 0);
    zebcore::debug::DebugDatabase::Instance().SetEntry(u8"EnableAUSupport", u8"true");
}

TEST_F(XAUScanTest, ThePathIsShownAsTheFullName)
{
    const FakeUnit unit(kAudioUnitType_Effect, "Maker: Named");
    EXPECT_EQ(GetPathDisplayString(unit.GetID()), u"Maker: Named");
    EXPECT_EQ(GetPathDisplayString(u"1 2 3"), u"1 2 3");
    EXPECT_EQ(GetDefaultAUPluginDirectories(), std::vector<UTF16String>{u"N/A"});
}

TEST_F(XAUScanTest, TheTechnologyWorksWithoutFolders)
{
    const auto technology = PluginModuleInfoManager::GetInstance().GetPluginTechnology(kTechnologyAudioUnit);
    ASSERT_TRUE(technology);
    EXPECT_FALSE(technology->HasDirectories());
}

TEST_F(XAUScanTest, RecordsWhatUnitsAreAndSkipsThoseThatGiveNone)
{
    FakeUnit unit(kAudioUnitType_Effect, "Maker: Scanned");
    unit.AnswerList(Global(kAudioUnitProperty_SupportedNumChannels), std::vector<AUChannelInfo>{{2, 2}});
    FakeUnit none;
    none.mGivesInstance = false;
    const boost::intrusive_ptr<PluginScanContext> context = CreateScanContext({});
    EXPECT_FALSE(context->Continue()) << "nothing to do yet";
    context->SetPluginLocators({LocatorOf(none), LocatorOf(unit)}, false);
    PluginLocator locator;
    UTF16String detail = u"before";
    unsigned long index = 9;
    ASSERT_TRUE(context->GetCurrentProgressInfo(locator, detail, index));
    EXPECT_TRUE(locator == LocatorOf(none));
    EXPECT_EQ(detail, u"");
    EXPECT_EQ(index, 0U);
    EXPECT_TRUE(context->Continue());
    EXPECT_FALSE(context->Continue());
    EXPECT_FALSE(context->GetCurrentProgressInfo(locator, detail, index));
    EXPECT_FALSE(context->Continue());

    EXPECT_FALSE(PluginModuleInfoManager::GetInstance().FindPluginInfo(LocatorOf(none)));
    const auto info = PluginModuleInfoManager::GetInstance().FindPluginInfo(LocatorOf(unit));
    ASSERT_TRUE(info);
    EXPECT_EQ(info->GetName(), u"Scanned");
    EXPECT_EQ(info->GetVersion(), 0x00020001);
    EXPECT_TRUE(info->HasAnyNonSynthEffect());
    for (const UTF16String& id : {u"4:" + unit.GetID(), unit.GetID()})
        EXPECT_TRUE(AudioFilterFactory::GetInstance().CreateAudioFilter(id));
}

TEST_F(XAUScanTest, GoesOnToTheNextUnitWhereverOneThrows)
{
    for (const char* call : {"create", "open", "get property info", "get property", "set property", "initialize",
                             "uninitialize", "close"})
    {
        FakeUnit thrower;
        thrower.mThrowsIn = {call};
        const FakeUnit next;
        const boost::intrusive_ptr<PluginScanContext> context = CreateScanContext({});
        context->SetPluginLocators({LocatorOf(thrower), LocatorOf(next)}, false);
        EXPECT_TRUE(context->Continue()) << call;
        EXPECT_FALSE(context->Continue()) << call;
        EXPECT_TRUE(PluginModuleInfoManager::GetInstance().FindPluginInfo(LocatorOf(next))) << call;
    }
}

TEST_F(XAUScanTest, DescribesTheChannelsThatAUnitTakes)
{
    struct Case
    {
        AUChannelInfo pair;
        bool mono;
        bool stereo;
    };
    for (const Case& c : {Case{{1, 1}, true, false}, Case{{2, 2}, false, true}, Case{{-1, -1}, true, true},
                          Case{{0, 2}, false, false}})
    {
        FakeUnit unit(kAudioUnitType_Effect, "Maker: Channels");
        unit.AnswerList(Global(kAudioUnitProperty_SupportedNumChannels), std::vector<AUChannelInfo>{c.pair});
        std::vector<boost::intrusive_ptr<AudioFilterDescriptor>> descriptors;
        ASSERT_TRUE(XAUAudioFilter::EnumerateFilters(LocatorOf(unit), 0, 0, descriptors));
        ASSERT_EQ(descriptors.size(), 1U);
        EXPECT_EQ(descriptors[0]->GetSupportsMono(), c.mono) << c.pair.inChannels;
        EXPECT_EQ(descriptors[0]->GetSupportsStereo(), c.stereo) << c.pair.inChannels;
        EXPECT_EQ(descriptors[0]->GetName(), u"Channels");
        EXPECT_EQ(descriptors[0]->GetVendorString(), u"Maker");
        EXPECT_FALSE(descriptors[0]->IsSynth());
    }
    std::vector<boost::intrusive_ptr<AudioFilterDescriptor>> descriptors(3);
    EXPECT_FALSE(XAUAudioFilter::EnumerateFilters(PluginLocator(kTechnologyAudioUnit, u"1 2 3"), 0, 0, descriptors));
    EXPECT_TRUE(descriptors.empty());
}

} // namespace
} // namespace zebaudiofilterhost::xau
