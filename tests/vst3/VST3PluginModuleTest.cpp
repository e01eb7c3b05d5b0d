#include "host/src/VST3/src/VST3PluginModule.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "host/BannedPluginManager.h"
#include "host/src/VST3/src/VST3AudioFilter.h"
#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <vector>

namespace zebaudiofilterhost::vst3
{

namespace
{

using zebtest::EffectBundle;
using zebtest::FixtureBundle;
using zebtest::RecorderOf;
using ModulePtr = boost::intrusive_ptr<VST3PluginModule>;
using Texts = std::vector<std::string>;

UTF16String PathOf(const std::filesystem::path& path)
{
    return zebcore::filesupport::FromNativePath(path.string());
}

ModulePtr MakeModule(std::string_view fixture)
{
    return new VST3PluginModule(PathOf(FixtureBundle(fixture)));
}

std::string ProblemOf(const std::filesystem::path& path)
{
    return zebcore::utility::NarrowFromUTF16(PluginModule::GetLoadProblem(PathOf(path)));
}

// What was traced while it lives, without the thread.
class TraceLines
{
public:
    TraceLines()
    {
        zebcore::debug::SetTraceSink(
            [this](std::string_view line)
            { mLines.emplace_back(line.substr(line.find("> <") + 2, line.size() - line.find("> <") - 3)); });
        zebcore::debug::SetAllTraceEnabled(true);
    }
    ~TraceLines()
    {
        zebcore::debug::SetAllTraceEnabled(false);
        zebcore::debug::SetTraceSink({});
    }
    TraceLines(const TraceLines&) = delete;
    TraceLines& operator=(const TraceLines&) = delete;

    const Texts& Get() const { return mLines; }

private:
    Texts mLines;
};

class VST3PluginModuleTest : public testing::Test
{
protected:
    static void SetUpTestSuite() { Initialize(); }
    static void TearDownTestSuite() { Terminate(); }
};

TEST_F(VST3PluginModuleTest, EntersBeforeItAsksForTheFactory)
{
    const auto recorder = RecorderOf(FixtureBundle("Normal"));
    recorder.Clear();
    const ModulePtr module = MakeModule("Normal");
    EXPECT_EQ(module->GetOSModule(), nullptr);
    ASSERT_TRUE(module->Load());
    EXPECT_EQ(recorder.CallsTo("module"), (Texts{"module.ModuleEntry 1", "module.GetPluginFactory"}));
    EXPECT_FALSE(module->Load()) << "a second load is refused";
    EXPECT_NE(module->GetOSModule(), nullptr);
    std::vector<UTF16String> ids;
    EXPECT_NE(module->GetPluginInfo(ids), nullptr) << "and leaves the factory alone";
}

TEST_F(VST3PluginModuleTest, UnloadReleasesFactoryThenExits)
{
    const auto recorder = RecorderOf(FixtureBundle("Normal"));
    recorder.Set("recordFactoryReferences", 1);
    const ModulePtr module = MakeModule("Normal");
    ASSERT_TRUE(module->Load());
    recorder.Clear();
    module->Unload();
    EXPECT_EQ(recorder.Calls(), (Texts{"factory.release", "module.ModuleExit"}));
    EXPECT_EQ(module->GetOSModule(), nullptr);
    module->Unload();
    std::vector<UTF16String> ids = {u"old"};
    EXPECT_EQ(module->GetPluginInfo(ids), nullptr);
    EXPECT_TRUE(ids.empty());
    EXPECT_EQ(module->CreateAudioFilter(u"3:1 2 3 4"), nullptr);
    EXPECT_EQ(recorder.Calls().size(), 2U) << "nothing is called in a module that was left";
    EXPECT_TRUE(module->Load());
    EXPECT_NE(module->GetPluginInfo(ids), nullptr);
    recorder.Reset();
}

TEST_F(VST3PluginModuleTest, ADestroyedModuleTellsThePluginNothing)
{
    const auto recorder = RecorderOf(FixtureBundle("Normal"));
    recorder.Set("recordFactoryReferences", 1);
    ModulePtr module = MakeModule("Normal");
    ASSERT_TRUE(module->Load());
    recorder.Clear();
    module.reset();
    EXPECT_EQ(recorder.Calls(), Texts());
    recorder.Reset();
}

TEST_F(VST3PluginModuleTest, EntryPointsAreOptionalAndHaveOtherNames)
{
    struct Case
    {
        const char* mName;
        Texts mCalls;
    };
    const Case cases[] = {
        {"NoEntry", {"module.GetPluginFactory"}},
        {"ForeignEntryNames", {"module.bundleEntry 1", "module.GetPluginFactory", "module.bundleExit"}},
        {"EntryRefuses", {"module.ModuleEntry 1", "module.GetPluginFactory", "module.ModuleExit"}},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        const auto recorder = RecorderOf(FixtureBundle(test.mName));
        recorder.Clear();
        const ModulePtr module = MakeModule(test.mName);
        EXPECT_TRUE(module->Load()) << "the answer of the entry function is ignored";
        module->Unload();
        EXPECT_EQ(recorder.CallsTo("module"), test.mCalls);
    }
}

TEST_F(VST3PluginModuleTest, TracesWhatItDoes)
{
    const std::string path = FixtureBundle("NullFactory").string();
    TraceLines trace;
    EXPECT_FALSE(MakeModule("NullFactory")->Load());
    EXPECT_EQ(trace.Get(),
              (Texts{"<VST3PluginModule::Load> <6> Path:" + path, "<InitPluginModule> <6> Calling ModuleEntry",
                     "<VST3PluginModule::Load> <6> Unloading due to error"}));
}

TEST_F(VST3PluginModuleTest, TracesTheRoadToAFilter)
{
    const std::string path = FixtureBundle("TwoEffects").string();
    const ModulePtr module = MakeModule("TwoEffects");
    ASSERT_TRUE(module->Load());
    TraceLines trace;
    EXPECT_EQ(module->CreateVST3AudioFilter(u"3:1 2 3 4"), nullptr);
    std::vector<UTF16String> ids;
    module->GetPluginInfo(ids);
    EXPECT_EQ(trace.Get(),
              (Texts{"<VST3PluginModule::CreateAudioFilter> <6> ID: 3:1 2 3 4, Path:" + path,
                     "<VST3PluginModule::CreateAudioFilter> <6> mFactory->countClasses(): 4",
                     "<VST3PluginModule::GetPluginInfo> <6> entry", "<VST3PluginModule::GetPluginInfo> <6> done"}));
}

TEST_F(VST3PluginModuleTest, AFailedLoadLeavesWithoutExitAndSaysWhy)
{
    struct Case
    {
        const char* mName;
        const char* mProblem; // after the path
    };
    const Case cases[] = {
        {"NoFactory", " is not a VST 3 plug-in: it does not export GetPluginFactory."},
        {"NullFactory", " does not work: its GetPluginFactory gives no factory."},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        const auto path = FixtureBundle(test.mName);
        const auto recorder = RecorderOf(path);
        recorder.Clear();
        EXPECT_EQ(GetVST3Plugin(PathOf(path)), nullptr);
        EXPECT_EQ(recorder.Count("module.ModuleEntry"), 1U);
        EXPECT_EQ(recorder.Count("module.ModuleExit"), 0U);
        EXPECT_EQ(ProblemOf(path), "\"" + path.string() + "\"" + test.mProblem);
        EXPECT_EQ(GetVST3Plugin(PathOf(path)), nullptr);
        EXPECT_EQ(recorder.Count("module.ModuleEntry"), 2U) << "the next call tries again";
    }
}

TEST_F(VST3PluginModuleTest, NamesTheBundleThatCannotBeLoaded)
{
    for (const char* name :
         {"WindowsOnly", "OtherArchitecture", "NotABinary", "ForeignBinary", "EmptyBundle", "PlainFile", "Nowhere"})
    {
        const auto path = FixtureBundle(name);
        EXPECT_EQ(GetVST3Plugin(PathOf(path)), nullptr);
        EXPECT_EQ(ProblemOf(path).find("\"" + path.string() + "\""), 0U) << ProblemOf(path);
    }
    EXPECT_NE(ProblemOf(FixtureBundle("WindowsOnly")).find("x86_64-win"), std::string::npos);
    EXPECT_NE(ProblemOf(FixtureBundle("PlainFile")).find("is a file"), std::string::npos);
    EXPECT_EQ(ProblemOf(FixtureBundle("Normal")), "") << "a bundle that loads has no problem";
}

TEST_F(VST3PluginModuleTest, ForgetsTheProblemWhenItIsSolved)
{
    const auto path = FixtureBundle("NullFactory");
    const auto recorder = RecorderOf(path);
    EXPECT_EQ(GetVST3Plugin(PathOf(path)), nullptr);
    recorder.Set("factoryIsNull", 0);
    EXPECT_TRUE(MakeModule("NullFactory")->Load());
    EXPECT_EQ(ProblemOf(path), "");
    recorder.Reset();
}

TEST_F(VST3PluginModuleTest, OneModuleForEachPath)
{
    const auto path = FixtureBundle("TwoEffects");
    const ModulePtr module = GetVST3Plugin(PathOf(path));
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(GetVST3Plugin(PathOf(path)), module);
    const UTF16String doubled = PathOf(path.parent_path()) + u"///" + PathOf(path.filename());
    const ModulePtr other = GetVST3Plugin(doubled);
    ASSERT_NE(other, nullptr);
    EXPECT_NE(other, module) << "a path in another form misses the cache";
    EXPECT_TRUE(other->GetPath() == PathOf(path));
    EXPECT_EQ(GetVST3Plugin(PathOf(path)), module) << "and the first module stays";
    module->Unload();
    EXPECT_EQ(GetVST3Plugin(PathOf(path)), module);
    EXPECT_NE(module->GetOSModule(), nullptr) << "loaded again";
}

TEST_F(VST3PluginModuleTest, DescribesBundles)
{
    struct Case
    {
        const char* mName;
        bool mHasInfo;
        std::size_t mClasses;
        const char16_t* mVendor;
    };
    const Case cases[] = {
        {"Normal", true, 1, u"Zeb Fixtures"},         {"TwoEffects", true, 2, u"Zeb Fixtures"},
        {"ControllerOnly", true, 0, u"Zeb Fixtures"}, {"NoClasses", false, 0, u""},
        {"NegativeClassCount", false, 0, u""},        {"HugeClassCount", true, 1, u"Zeb Fixtures"},
        {"ClassInfoFails", true, 1, u"Zeb Fixtures"}, {"FactoryInfoFails", true, 1, u""},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        const auto path = FixtureBundle(test.mName);
        const ModulePtr module = GetVST3Plugin(PathOf(path));
        ASSERT_NE(module, nullptr);
        std::vector<UTF16String> ids = {u"old", u"older", u"oldest"};
        const auto info = module->GetPluginInfo(ids);
        EXPECT_EQ(ids.size(), test.mClasses);
        ASSERT_EQ(info != nullptr, test.mHasInfo);
        if (!info)
            continue;
        EXPECT_TRUE(info->GetLocator() == PluginLocator(kTechnologyVST3, PathOf(path)));
        EXPECT_TRUE(info->GetName() == PathOf(test.mName));
        EXPECT_TRUE(info->GetVendor() == test.mVendor);
        EXPECT_EQ(info->GetVersion(), 0U);
        EXPECT_EQ(info->GetType(), kTechnologyVST3);
        EXPECT_TRUE(info->IsEnabled());
        EXPECT_EQ(info->IsShell(), test.mClasses > 1);
    }
}

TEST_F(VST3PluginModuleTest, HonoursThePermanentBlockList)
{
    const auto listPath = std::filesystem::temp_directory_path() / "zebvst3_permanent.xml";
    std::ofstream(listPath) << R"(<pluginlist><plugin filename="NORMAL.vst3" uniqueid="" version=""/></pluginlist>)";
    File list(PathOf(listPath));
    ASSERT_TRUE(BannedPluginManager::GetInstance().LoadStaticConfiguration(list));
    std::vector<UTF16String> ids = {u"old"};
    EXPECT_EQ(GetVST3Plugin(PathOf(FixtureBundle("Normal")))->GetPluginInfo(ids), nullptr);
    EXPECT_TRUE(ids.empty());
    std::ofstream(listPath) << "<pluginlist></pluginlist>";
    ASSERT_TRUE(BannedPluginManager::GetInstance().LoadStaticConfiguration(list));
    EXPECT_NE(GetVST3Plugin(PathOf(FixtureBundle("Normal")))->GetPluginInfo(ids), nullptr);
    std::filesystem::remove(listPath);
}

TEST_F(VST3PluginModuleTest, MakesFiltersByClassID)
{
    const ModulePtr module = GetVST3Plugin(PathOf(EffectBundle("ZebTrio")));
    ASSERT_NE(module, nullptr);
    std::vector<UTF16String> ids;
    module->GetPluginInfo(ids);
    ASSERT_EQ(ids.size(), 3U);
    EXPECT_TRUE(ids[0] == u"3:5a656254 72696f00 40000000 1");
    for (const UTF16String& id : ids)
    {
        const boost::intrusive_ptr<AudioFilter> filter = module->CreateAudioFilter(id);
        ASSERT_NE(filter, nullptr);
        EXPECT_TRUE(filter->GetID() == id);
    }
    EXPECT_NE(module->CreateAudioFilter(u"5a656254 72696f00 40000000 2"), nullptr) << "the prefix is optional";
    EXPECT_EQ(module->CreateAudioFilter(u"3:5a656254 72696f00 40000000 9"), nullptr);
    EXPECT_EQ(module->CreateAudioFilter(u"nonsense"), nullptr);
    EXPECT_EQ(CreateAudioFilter(ids[0]), nullptr) << "nothing in the catalogue has this ID yet";
}

} // namespace

} // namespace zebaudiofilterhost::vst3
