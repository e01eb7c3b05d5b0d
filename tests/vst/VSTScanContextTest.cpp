#include "host/src/VST/src/VSTScanContext.h"

#include "foundation/zebcore/NativePath.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterFactory.h"
#include "host/PluginModuleInfoManager.h"
#include "host/VST/VSTTechnology.h"
#include "host/src/VST/src/VSTFilterID.h"
#include "host/src/VST/src/VSTPluginSearch.h"
#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/plugins/vst2/FixtureID.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string_view>
#include <utility>
#include <vector>

namespace zebaudiofilterhost::vst
{

namespace
{

using zebtest::VST2Fixture;

PluginLocator Fixture(std::string_view name)
{
    return {kTechnologyVST, zebcore::filesupport::FromNativePath(VST2Fixture(name).string())};
}

UTF16String MemberID(std::string_view name, unsigned int member = 0)
{
    return EncodeFilterID(zebtest::VST2FixtureID(name) + member, Fixture(name).GetPath());
}

boost::intrusive_ptr<AudioFilterDescriptor> DescriptorOf(const UTF16String& id)
{
    return AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(id);
}

boost::intrusive_ptr<PluginModuleInfo> InfoOf(const PluginLocator& locator)
{
    return PluginModuleInfoManager::GetInstance().FindPluginInfo(locator);
}

class VSTScanContextTest : public testing::Test
{
protected:
    static void SetUpTestSuite() { Initialize(); }
    static void TearDownTestSuite() { Terminate(); }

    VSTScanContextTest() { PluginModuleInfoManager::GetInstance().ClearAll(false); }
    ~VSTScanContextTest() override { PluginModuleInfoManager::GetInstance().ClearAll(false); }

    // Detail and position of what the next step works on.
    std::pair<UTF16String, unsigned long> Progress() const
    {
        PluginLocator locator;
        UTF16String detail = u"old";
        unsigned long index = 99;
        EXPECT_TRUE(mContext->GetCurrentProgressInfo(locator, detail, index));
        return {detail, index};
    }

    void Scan(const std::vector<PluginLocator>& locators) const
    {
        mContext->SetPluginLocators(locators, false);
        while (mContext->Continue())
        {
        }
    }

    boost::intrusive_ptr<PluginScanContext> mContext = CreateScanContext({});
};

TEST_F(VSTScanContextTest, OneMemberAStepAndAllAtTheLast)
{
    using Step = std::pair<UTF16String, unsigned long>;
    mContext->SetPluginLocators({Fixture("Shell"), Fixture("Normal")}, false);
    EXPECT_TRUE(Progress() == Step(u"", 0)) << "the members are not known yet";
    EXPECT_TRUE(mContext->Continue());
    EXPECT_TRUE(Progress() == Step(u" (2/3)", 0));
    EXPECT_TRUE(mContext->Continue());
    EXPECT_TRUE(Progress() == Step(u" (3/3)", 0));
    EXPECT_EQ(InfoOf(Fixture("Shell")), nullptr) << "nothing is registered before the last member";
    EXPECT_TRUE(mContext->Continue());
    ASSERT_NE(InfoOf(Fixture("Shell")), nullptr);
    EXPECT_TRUE(InfoOf(Fixture("Shell"))->HasAnyNonSynthEffect());
    EXPECT_TRUE(InfoOf(Fixture("Shell"))->IsShell());
    for (unsigned int member = 0; member < 3; ++member)
        EXPECT_NE(DescriptorOf(MemberID("Shell", member)), nullptr);
    EXPECT_TRUE(Progress() == Step(u"", 1));
    EXPECT_FALSE(mContext->Continue());
    EXPECT_NE(DescriptorOf(MemberID("Normal")), nullptr);
}

TEST_F(VSTScanContextTest, EachBinaryThatGivesNothingTakesOneStep)
{
    struct Case
    {
        const char* mName;
        bool mHasInfo;
    };
    const Case cases[] = {
        {"Helper", false},      {"Nowhere", false},   {"NullEntry", false}, {"WrongMagic", false},
        {"Version2299", false}, {"EmptyShell", true}, {"Synth", true},
    };
    std::vector<PluginLocator> locators;
    for (const Case& test : cases)
        locators.push_back(Fixture(test.mName));
    locators.push_back(Fixture("Normal"));
    mContext->SetPluginLocators(locators, false);
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        EXPECT_TRUE(mContext->Continue());
        const auto info = InfoOf(Fixture(test.mName));
        EXPECT_EQ(info != nullptr, test.mHasInfo);
        EXPECT_FALSE(info && info->HasAnyNonSynthEffect());
        EXPECT_EQ(DescriptorOf(MemberID(test.mName)), nullptr);
    }
    EXPECT_FALSE(mContext->Continue());
    EXPECT_TRUE(InfoOf(Fixture("Normal"))->HasAnyNonSynthEffect()) << "the others do not suffer";
}

TEST_F(VSTScanContextTest, InstrumentsOfAShellAreLeftOut)
{
    Scan({Fixture("MixedShell")});
    EXPECT_NE(DescriptorOf(MemberID("MixedShell", 0)), nullptr);
    EXPECT_EQ(DescriptorOf(MemberID("MixedShell", 1)), nullptr);
    EXPECT_NE(DescriptorOf(MemberID("MixedShell", 2)), nullptr);
    EXPECT_TRUE(InfoOf(Fixture("MixedShell"))->HasAnyNonSynthEffect());
}

TEST_F(VSTScanContextTest, ClosesEachPluginAfterItsStep)
{
    const auto recorder = zebtest::RecorderOf(VST2Fixture("Shell"));
    recorder.Clear();
    mContext->SetPluginLocators({Fixture("Shell")}, false);
    for (std::size_t step = 1; step <= 3; ++step)
    {
        EXPECT_EQ(mContext->Continue(), step < 3);
        EXPECT_EQ(recorder.LiveObjects(), 0);
        EXPECT_EQ(recorder.Count("effOpen"), step + 1) << "one for the list of members";
    }
}

TEST_F(VSTScanContextTest, WhatIsThrownPassesThroughAndTheStepStays)
{
    const auto recorder = zebtest::RecorderOf(VST2Fixture("ThrowsInVersion"));
    mContext->SetPluginLocators({Fixture("ThrowsInVersion"), Fixture("Normal")}, false);
    for (int attempt = 0; attempt < 2; ++attempt)
    {
        EXPECT_THROW(mContext->Continue(), std::runtime_error);
        EXPECT_TRUE(Progress() == std::pair(UTF16String(), 0UL));
        EXPECT_EQ(recorder.LiveObjects(), 0);
    }
    EXPECT_EQ(InfoOf(Fixture("ThrowsInVersion")), nullptr);
    Scan({Fixture("Normal")});
    EXPECT_NE(InfoOf(Fixture("Normal")), nullptr) << "the context can be used for the plug-ins that are left";
}

TEST_F(VSTScanContextTest, AnAbandonedBinaryLeavesNothing)
{
    mContext->SetPluginLocators({Fixture("Shell")}, false);
    EXPECT_TRUE(mContext->Continue());
    mContext.reset();
    EXPECT_EQ(InfoOf(Fixture("Shell")), nullptr);
    EXPECT_EQ(DescriptorOf(MemberID("Shell")), nullptr);
}

TEST_F(VSTScanContextTest, WhatWasFoundCanBeMadeUnderItsName)
{
    Scan({Fixture("Shell"), Fixture("Normal")});
    const UTF16String id = MemberID("Shell", 1);
    const auto filter = AudioFilterFactory::GetInstance().CreateAudioFilter(id);
    ASSERT_NE(filter, nullptr);
    EXPECT_TRUE(filter->GetID() == id);
    EXPECT_TRUE(filter->GetDisplayName() == u"Second Member");
    const auto old = CreateAudioFilter(id.substr(2));
    ASSERT_NE(old, nullptr) << "an ID without its technology";
    EXPECT_TRUE(old->GetID() == id);
    EXPECT_EQ(CreateAudioFilter(MemberID("Shell", 9)), nullptr);
}

TEST_F(VSTScanContextTest, TheCataloguesNameWins)
{
    // No scan: whoever fills the catalogue says how an effect is called.
    AudioFilterDescriptorManager::GetInstance().AddAudioFilterDescriptor(new AudioFilterDescriptor(
        Fixture("Normal"), u"Renamed", u"", 0, kCategoryNone, MemberID("Normal"), GetVSTFactoryGuid(), false));
    const auto filter = CreateAudioFilter(MemberID("Normal"));
    ASSERT_NE(filter, nullptr);
    EXPECT_TRUE(filter->GetDisplayName() == u"Renamed");
}

TEST_F(VSTScanContextTest, TheTechnologyIsRegistered)
{
    const auto technology = PluginModuleInfoManager::GetInstance().GetPluginTechnology(kTechnologyVST);
    ASSERT_NE(technology, nullptr);
    EXPECT_TRUE(technology->HasDirectories());
    EXPECT_NE(technology->CreateScanContext(), nullptr);
    EXPECT_TRUE(technology->GetPathDisplayString(u"/a/b.vst") == u"/a/b.vst");
    technology->ResetDirectoriesToDefault();
    const std::vector<UTF16String> directories(technology->DirectoryBegin(), technology->DirectoryEnd());
    EXPECT_TRUE(directories == GetDefaultVSTPluginDirectories());
    technology->RemoveAllPluginDirectories();
    technology->AddPluginDirectories({zebcore::filesupport::FromNativePath(zebtest::VST2FixtureFolder().string())});
    const auto found = technology->CollectPlugins();
    EXPECT_NE(std::find(found.begin(), found.end(), Fixture("Bundled")), found.end());
    EXPECT_NE(std::find(found.begin(), found.end(), Fixture("Normal")), found.end());
    EXPECT_EQ(std::find(found.begin(), found.end(), Fixture("Helper")), found.end());
    technology->RemoveAllPluginDirectories();
}

} // namespace

} // namespace zebaudiofilterhost::vst
