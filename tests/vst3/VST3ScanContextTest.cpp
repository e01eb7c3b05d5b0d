#include "host/src/VST3/src/VST3ScanContext.h"

#include "audiofilter/AudioFilter.h"
#include "foundation/zebcore/NativePath.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/AudioFilterFactory.h"
#include "host/PluginModuleInfoManager.h"
#include "host/VST3/VST3Technology.h"
#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"

#include <gtest/gtest.h>

#include <string_view>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

PluginLocator LocatorOf(const std::filesystem::path& path)
{
    return {kTechnologyVST3, zebcore::filesupport::FromNativePath(path.string())};
}

PluginLocator Fixture(std::string_view name)
{
    return LocatorOf(zebtest::FixtureBundle(name));
}

const PluginLocator& Trio()
{
    static const PluginLocator sTrio = LocatorOf(zebtest::EffectBundle("ZebTrio"));
    return sTrio;
}

constexpr const char16_t* kTremolo = u"3:5a656254 72696f00 40000000 1";
constexpr const char16_t* kTilt = u"3:5a656254 72696f00 40000000 2";
constexpr const char16_t* kTone = u"3:5a656254 72696f00 40000000 3";

bool IsInCatalogue(const UTF16String& id)
{
    return AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(id) != nullptr;
}

class VST3ScanContextTest : public testing::Test
{
protected:
    static void SetUpTestSuite() { Initialize(); }
    static void TearDownTestSuite() { Terminate(); }

    VST3ScanContextTest() { PluginModuleInfoManager::GetInstance().ClearAll(false); }
    ~VST3ScanContextTest() override { PluginModuleInfoManager::GetInstance().ClearAll(false); }

    // Detail and position of what the next step works on.
    std::pair<UTF16String, unsigned long> Progress(const PluginLocator& expected) const
    {
        PluginLocator locator;
        UTF16String detail = u"old";
        unsigned long index = 99;
        EXPECT_TRUE(mContext->GetCurrentProgressInfo(locator, detail, index));
        EXPECT_TRUE(locator == expected);
        return {detail, index};
    }

    bool IsFinished() const
    {
        PluginLocator locator = Trio();
        UTF16String detail = u"old";
        unsigned long index = 99;
        const bool goesOn = mContext->GetCurrentProgressInfo(locator, detail, index);
        EXPECT_TRUE(goesOn || (locator == Trio() && detail == u"old" && index == 99)) << "nothing is written";
        return !goesOn;
    }

    boost::intrusive_ptr<PluginModuleInfo> InfoOf(const PluginLocator& locator) const
    {
        return PluginModuleInfoManager::GetInstance().FindPluginInfo(locator);
    }

    boost::intrusive_ptr<PluginScanContext> mContext = CreateScanContext({});
};

TEST_F(VST3ScanContextTest, NothingToDo)
{
    EXPECT_TRUE(IsFinished());
    EXPECT_FALSE(mContext->Continue());
    mContext->SetPluginLocators({}, false);
    EXPECT_FALSE(mContext->Continue());
}

TEST_F(VST3ScanContextTest, OneClassAStepAndAllAtTheLast)
{
    mContext->SetPluginLocators({Trio(), Fixture("Normal")}, false);
    EXPECT_TRUE(Progress(Trio()) == std::make_pair(UTF16String(), 0UL)) << "the classes are not known yet";
    EXPECT_TRUE(mContext->Continue());
    EXPECT_TRUE(Progress(Trio()) == std::make_pair(UTF16String(u" (2/3)"), 0UL));
    EXPECT_TRUE(mContext->Continue());
    EXPECT_TRUE(Progress(Trio()) == std::make_pair(UTF16String(u" (3/3)"), 0UL));
    EXPECT_FALSE(IsInCatalogue(kTremolo)) << "nothing is registered before the last class";
    EXPECT_EQ(InfoOf(Trio()), nullptr);
    EXPECT_TRUE(mContext->Continue());
    EXPECT_TRUE(IsInCatalogue(kTremolo));
    EXPECT_TRUE(IsInCatalogue(kTilt));
    EXPECT_FALSE(IsInCatalogue(kTone)) << "instruments are left out";
    ASSERT_NE(InfoOf(Trio()), nullptr);
    EXPECT_TRUE(InfoOf(Trio())->HasAnyNonSynthEffect());
    EXPECT_TRUE(InfoOf(Trio())->IsShell());
    EXPECT_TRUE(Progress(Fixture("Normal")) == std::make_pair(UTF16String(), 1UL));
    EXPECT_FALSE(mContext->Continue());
    EXPECT_TRUE(IsFinished());
    EXPECT_NE(InfoOf(Fixture("Normal")), nullptr);
}

TEST_F(VST3ScanContextTest, EachBundleThatGivesNothingTakesOneStep)
{
    struct Case
    {
        const char* mName;
        bool mHasInfo;
    };
    const Case cases[] = {
        {"NoFactory", false},     {"WindowsOnly", false}, {"NoClasses", false},      {"ControllerOnly", true},
        {"InstrumentOnly", true}, {"NoProcessor", true},  {"InitializeFails", true}, {"ComponentMissing", true},
    };
    std::vector<PluginLocator> locators;
    for (const Case& test : cases)
        locators.push_back(Fixture(test.mName));
    locators.push_back(Fixture("Normal"));
    mContext->SetPluginLocators(locators, false);
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        EXPECT_TRUE(Progress(Fixture(test.mName)).first.empty());
        EXPECT_TRUE(mContext->Continue());
        const auto info = InfoOf(Fixture(test.mName));
        EXPECT_EQ(info != nullptr, test.mHasInfo);
        EXPECT_FALSE(info && info->HasAnyNonSynthEffect());
    }
    EXPECT_FALSE(mContext->Continue());
    EXPECT_TRUE(InfoOf(Fixture("Normal"))->HasAnyNonSynthEffect()) << "the others do not suffer";
}

TEST_F(VST3ScanContextTest, StartingOverForgetsTheBundleInProgress)
{
    mContext->SetPluginLocators({Trio()}, false);
    EXPECT_TRUE(mContext->Continue());
    mContext->SetPluginLocators({Fixture("Normal")}, false);
    EXPECT_TRUE(Progress(Fixture("Normal")).first.empty());
    EXPECT_FALSE(mContext->Continue());
    ASSERT_NE(InfoOf(Fixture("Normal")), nullptr);
    EXPECT_FALSE(InfoOf(Fixture("Normal"))->HasAnyNonSynthEffect()) << "its only class lies before the old index";
    EXPECT_EQ(InfoOf(Trio()), nullptr);
    mContext->SetPluginLocators({Trio()}, false);
    EXPECT_TRUE(mContext->Continue());
    mContext.reset();
    EXPECT_EQ(InfoOf(Trio()), nullptr) << "an interrupted scan registers nothing of its bundle";
    EXPECT_FALSE(IsInCatalogue(kTremolo));
}

TEST_F(VST3ScanContextTest, DropsEachPluginAfterItsStep)
{
    const auto recorder = zebtest::RecorderOf(zebtest::FixtureBundle("TwoEffects"));
    recorder.Clear();
    mContext->SetPluginLocators({Fixture("TwoEffects")}, false);
    EXPECT_TRUE(mContext->Continue());
    EXPECT_EQ(recorder.LiveObjects(), 0);
    EXPECT_EQ(recorder.Count("factory.createInstance component"), 1U);
    EXPECT_FALSE(mContext->Continue());
    EXPECT_EQ(recorder.LiveObjects(), 0);
    EXPECT_EQ(recorder.Count("factory.createInstance component"), 2U);
}

TEST_F(VST3ScanContextTest, WithSkipCategoryInstrumentsAreNotKnown)
{
    mContext->SetPluginLocators({Trio()}, true);
    while (mContext->Continue())
    {
    }
    EXPECT_TRUE(IsInCatalogue(kTone));
    const auto descriptor = AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(kTilt);
    ASSERT_NE(descriptor, nullptr);
    EXPECT_EQ(descriptor->GetCategory(), kCategoryNotQueried);
}

TEST_F(VST3ScanContextTest, WhatWasFoundCanBeMade)
{
    mContext->SetPluginLocators({Trio()}, false);
    while (mContext->Continue())
    {
    }
    const auto filter = AudioFilterFactory::GetInstance().CreateAudioFilter(kTilt);
    ASSERT_NE(filter, nullptr);
    EXPECT_TRUE(filter->GetID() == kTilt);
    EXPECT_EQ(AudioFilterFactory::GetInstance().CreateAudioFilter(kTone), nullptr);
}

TEST_F(VST3ScanContextTest, TheTechnologyIsRegistered)
{
    const auto technology = PluginModuleInfoManager::GetInstance().GetPluginTechnology(kTechnologyVST3);
    ASSERT_NE(technology, nullptr);
    EXPECT_FALSE(technology->HasDirectories());
    EXPECT_NE(technology->CreateScanContext(), nullptr);
    EXPECT_TRUE(technology->GetPathDisplayString(u"/a/b.vst3") == u"/a/b.vst3");
    technology->ResetDirectoriesToDefault();
    EXPECT_TRUE(technology->DirectoryBegin() == technology->DirectoryEnd());
}

} // namespace

} // namespace zebaudiofilterhost::vst3
