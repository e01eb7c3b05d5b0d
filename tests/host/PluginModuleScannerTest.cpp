#include "host/PluginModuleScanner.h"

#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "tests/host/FakeTechnology.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;
using ScannerPtr = boost::intrusive_ptr<PluginModuleScanner>;

class PluginModuleScannerTest : public FakeTechnologyFixture
{
protected:
    static ScannerPtr Begin(const std::vector<PluginLocator>& locators, bool skipCategory = false)
    {
        const ScannerPtr scanner = new PluginModuleScanner(locators, skipCategory);
        scanner->BeginScan();
        return scanner;
    }

    /// What the scanner announces, as "current/total locator detail"; empty when it is finished.
    static std::string Announced(const PluginModuleScanner& scanner)
    {
        PluginLocator locator(kTechnologyNone, u"untouched");
        UTF16String detail = u"untouched";
        int current = -1;
        int total = -1;
        if (!scanner.GetCurrentProgressInfo(locator, detail, current, total))
        {
            return {};
        }
        return std::to_string(current) + "/" + std::to_string(total) + " " + Text(locator) + Text(detail);
    }

    /// The whole loop of a caller: what was announced before each step.
    static Strings Run(PluginModuleScanner& scanner)
    {
        Strings announced;
        for (std::string next = Announced(scanner); !next.empty(); next = Announced(scanner))
        {
            announced.push_back(next);
            scanner.ContinueScan();
        }
        scanner.EndScan();
        return announced;
    }

    PluginModuleInfoManager& mInfos = PluginModuleInfoManager::GetInstance();
};

} // namespace

TEST_F(PluginModuleScannerTest, NothingToDo)
{
    const ScannerPtr scanner = Begin({});
    PluginLocator locator = VST3(u"/mine");
    UTF16String detail = u"mine";
    int current = 5;
    int total = 6;
    EXPECT_FALSE(scanner->GetCurrentProgressInfo(locator, detail, current, total));
    EXPECT_EQ(Text(locator) + Text(detail), "3:/minemine");
    EXPECT_EQ(current + total, 11);
    EXPECT_FALSE(scanner->ContinueScan());
    scanner->EndScan();
}

TEST_F(PluginModuleScannerTest, WorksByTechnologyThenInTheCallersOrder)
{
    mMachine.plugins = {{VST3(u"/3a"), true, {{u"3:1"}}},
                        {VST3(u"/3b"), true, {{u"3:2"}, {u"3:3", true}, {u"3:4"}}},
                        {VST2(u"/2a"), true, {}},
                        {AudioUnit(u"4a"), false, {{u"4:1"}}}};
    const ScannerPtr scanner = Begin({AudioUnit(u"4a"), VST3(u"/3b"), VST2(u"/2a"), VST3(u"/3a"),
                                      PluginLocator(kTechnologyInternal, u""), PluginLocator()});
    EXPECT_TRUE(mMachine.log.empty()) << "construction loads nothing";

    // The step that finds VST 2 finished also does the first of VST 3, which was not announced.
    EXPECT_EQ(Run(*scanner), (Strings{"1/4 2:/2a", "2/4 3:/3b (2/3)", "2/4 3:/3b (3/3)", "3/4 3:/3a"}));
    EXPECT_EQ(mMachine.log, (Strings{"load 2:/2a", "load 3:/3b", "make 3:2", "make 3:3", "make 3:4", "load 3:/3a",
                                     "make 3:1", "load 4:4a"}));
    EXPECT_EQ(RecordPaths(), (Strings{"/2a", "/3b", "/3a"})) << "what fails to load leaves no record";
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:2", "3:4", "3:1"}));
    EXPECT_FALSE(scanner->ContinueScan());
}

TEST_F(PluginModuleScannerTest, ThreeFiltersAreThreeStepsUnderOneNumber)
{
    mMachine.plugins = {{VST3(u"/a"), true, {{u"3:1"}, {u"3:2"}, {u"3:3"}}}};
    const ScannerPtr scanner = Begin({VST3(u"/a")});
    EXPECT_EQ(Announced(*scanner), "1/1 3:/a");
    EXPECT_TRUE(scanner->ContinueScan());
    EXPECT_EQ(Announced(*scanner), "1/1 3:/a (2/3)");
    EXPECT_TRUE(scanner->ContinueScan());
    EXPECT_EQ(Announced(*scanner), "1/1 3:/a (3/3)");
    EXPECT_TRUE(CatalogueIDs().empty());
    EXPECT_FALSE(scanner->ContinueScan());
    EXPECT_EQ(Announced(*scanner), "");
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:1", "3:2", "3:3"}));
}

TEST_F(PluginModuleScannerTest, InstrumentsLeaveARecordAndNoDescriptor)
{
    mMachine.plugins = {{VST3(u"/synth"), true, {{u"3:1", true}, {u"3:2", true}}}};
    Run(*Begin({VST3(u"/synth")}));
    ASSERT_TRUE(mInfos.FindPluginInfo(VST3(u"/synth")));
    EXPECT_FALSE(mInfos.FindPluginInfo(VST3(u"/synth"))->HasAnyNonSynthEffect());
    EXPECT_TRUE(CatalogueIDs().empty());
}

TEST_F(PluginModuleScannerTest, SkipCategoryReachesTheContext)
{
    mMachine.plugins = {{VST3(u"/a"), true, {{u"3:1"}}}};
    for (const bool skip : {true, false})
    {
        mInfos.ClearAll(true);
        Run(*Begin({VST3(u"/a")}, skip));
        const auto descriptor = AudioFilterDescriptorManager::GetInstance().GetComponentDescriptorForID(u"3:1");
        ASSERT_TRUE(descriptor);
        EXPECT_EQ(descriptor->GetCategory() == kCategoryNotQueried, skip);
    }
}

TEST_F(PluginModuleScannerTest, ExceptionLeavesTheScanWhereItWas)
{
    mMachine.plugins = {{VST2(u"/a"), true, {{u"2:1"}}}, {VST3(u"/b"), true, {{u"3:1"}, {u"3:2", false, true}}}};
    const ScannerPtr scanner = Begin({VST2(u"/a"), VST3(u"/b")});
    EXPECT_TRUE(scanner->ContinueScan());
    EXPECT_THROW(scanner->ContinueScan(), std::runtime_error);
    EXPECT_EQ(Announced(*scanner), "2/2 3:/b (2/2)");
    EXPECT_FALSE(scanner->ContinueScan());
    EXPECT_EQ(CatalogueIDs(), (Strings{"2:1", "3:1", "3:2"}));
}

TEST_F(PluginModuleScannerTest, ExceptionInTheNextTechnologyKeepsTheFinishedShare)
{
    mMachine.plugins = {{VST2(u"/a"), true, {{u"2:1"}}}, {VST3(u"/b"), true, {{u"3:1", false, true}}}};
    const ScannerPtr scanner = Begin({VST2(u"/a"), VST3(u"/b")});
    EXPECT_THROW(scanner->ContinueScan(), std::runtime_error);
    EXPECT_EQ(RecordPaths(), Strings{"/a"});
    EXPECT_EQ(Announced(*scanner), "2/2 3:/b");
}

TEST_F(PluginModuleScannerTest, ContextThatTellsNothingEndsTheScanOnlyIfItIsTheLast)
{
    mMachine.plugins = {{VST2(u"/a")}, {VST3(u"/b"), true, {{u"3:1"}, {u"3:2"}}}};
    mMachine.tellsProgress = false;
    const ScannerPtr scanner = Begin({VST2(u"/a"), VST3(u"/b")});
    EXPECT_EQ(Announced(*scanner), "1/2 0:untoucheduntouched");
    EXPECT_TRUE(scanner->ContinueScan());
    EXPECT_EQ(Announced(*scanner), "");
    EXPECT_FALSE(scanner->ContinueScan());
}

TEST_F(PluginModuleScannerTest, DroppedScanForgetsThePluginInProgress)
{
    mMachine.plugins = {{VST3(u"/a"), true, {{u"3:1"}, {u"3:2"}}}};
    Begin({VST3(u"/a")})->ContinueScan();
    EXPECT_TRUE(RecordPaths().empty());
    EXPECT_TRUE(CatalogueIDs().empty());
}

TEST_F(PluginModuleScannerTest, EnabledStateAcrossAScan)
{
    mMachine.plugins = {{VST3(u"/was on"), true, {{u"3:1"}}},
                        {VST3(u"/was off"), true, {{u"3:2"}}},
                        {VST3(u"/fails now"), false, {}}};
    mInfos.AddPluginModuleInfo(MakeInfo(VST3(u"/was on"), true));
    mInfos.AddPluginModuleInfo(MakeInfo(VST3(u"/was off"), false));
    mInfos.AddPluginModuleInfo(MakeInfo(VST3(u"/fails now"), false));
    mInfos.AddPluginModuleInfo(MakeInfo(VST3(u"/vanishes"), true));
    mInfos.AddPluginModuleInfo(MakeInfo(VST3(u"/switched off meanwhile"), true));
    std::vector<PluginLocator> removed;
    const ScannerPtr scanner = Begin(mInfos.CollectPotentialPlugins(false, removed));
    mInfos.RemovePluginLocators({VST3(u"/vanishes")});
    mInfos.SetPluginEnabled(VST3(u"/switched off meanwhile"), false);
    Run(*scanner);
    EXPECT_EQ(Texts(mInfos.GetEnabledPlugins()), (Strings{"3:/switched off meanwhile", "3:/was off", "3:/was on"}));
    EXPECT_EQ(mInfos.FindPluginInfo(VST3(u"/vanishes")), nullptr);
    EXPECT_FALSE(mInfos.IsPluginEnabled(VST3(u"/fails now"), false)) << "no new record, so the old flag stays";
}

TEST_F(PluginModuleScannerTest, PluginThatTookTheProcessDownIsNotFoundAgain)
{
    mMachine.plugins = {{VST3(u"/bad"), true, {{u"3:1"}}}, {VST3(u"/good"), true, {{u"3:2"}}}};
    mInfos.AddPluginModuleInfo(MakeInfo(VST3(u"/bad")));
    std::vector<PluginLocator> removed;
    const ScannerPtr scanner = Begin(mInfos.CollectPotentialPlugins(false, removed));
    BannedPluginManager& banned = BannedPluginManager::GetInstance();
    File list = FileInFolder("dynamic.xml");

    PluginLocator announced;
    UTF16String detail;
    int current = 0;
    int total = 0;
    ASSERT_TRUE(scanner->GetCurrentProgressInfo(announced, detail, current, total));
    banned.AddBannedPlugin(announced);
    banned.SaveConfiguration(list);
    // Here the process dies. The next start:
    banned.ReadBannedPlugins(PropList());
    banned.LoadConfiguration(list);
    EXPECT_EQ(Texts(mInfos.CollectPotentialPlugins(true, removed)), Strings{"3:/good"});
    EXPECT_EQ(Texts(removed), Strings{"3:/bad"});
}

} // namespace zebaudiofilterhost::testing
