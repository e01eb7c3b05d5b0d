#include "host/src/VST/src/VSTPluginModule.h"

#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/Trace.h"
#include "host/AudioFilterDescriptorManager.h"
#include "host/BannedPluginManager.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTFilterID.h"
#include "module/Module.h"
#include "tests/persistence/TempFolder.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/plugins/vst2/FixtureID.h"

#include <gtest/gtest.h>

#include <stdexcept>
#include <string>
#include <vector>

namespace zebaudiofilterhost::vst
{

namespace
{

using zebtest::RecorderOf;
using zebtest::VST2Effect;
using zebtest::VST2Fixture;
using zebtest::VST2FixtureID;
using ModulePtr = boost::intrusive_ptr<VSTPluginModule>;
using Texts = std::vector<std::string>;

UTF16String PathOf(const std::filesystem::path& path)
{
    return zebcore::filesupport::FromNativePath(path.string());
}

ModulePtr LoadFixture(std::string_view name)
{
    return GetVSTPlugin(PathOf(VST2Fixture(name)));
}

UTF16String MemberID(std::string_view name, unsigned int member = 0)
{
    return EncodeFilterID(VST2FixtureID(name) + member, PathOf(VST2Fixture(name)));
}

std::string ProblemOf(const std::filesystem::path& path)
{
    return zebcore::utility::NarrowFromUTF16(PluginModule::GetLoadProblem(PathOf(path)));
}

// The permanent block list, for as long as it lives.
class PermanentList
{
public:
    explicit PermanentList(const std::string& entries)
    {
        mFolder.Write("list.xml", "<pluginlist>" + entries + "</pluginlist>");
        Load();
    }
    ~PermanentList()
    {
        mFolder.Write("list.xml", "<pluginlist></pluginlist>");
        Load();
    }
    PermanentList(const PermanentList&) = delete;
    PermanentList& operator=(const PermanentList&) = delete;

private:
    void Load() const
    {
        File list = mFolder.File("list.xml");
        EXPECT_TRUE(BannedPluginManager::GetInstance().LoadStaticConfiguration(list));
    }

    TempFolder mFolder;
};

class VSTPluginModuleTest : public testing::Test
{
protected:
    static void SetUpTestSuite() { Initialize(); }
    static void TearDownTestSuite() { Terminate(); }
};

TEST_F(VSTPluginModuleTest, FindsTheEntryPointByItsNames)
{
    struct Case
    {
        const char* mName;
        const char* mEntry; // what was called
    };
    const Case cases[] = {
        {"Normal", "VSTPluginMain 1"},
        {"BothEntries", "VSTPluginMain 1"},
        {"MachoEntry", "main_macho 1"},
        {"OldMain", "main 1"},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        const auto recorder = RecorderOf(VST2Fixture(test.mName));
        recorder.Clear();
        const ModulePtr module(new VSTPluginModule(PathOf(VST2Fixture(test.mName))));
        EXPECT_EQ(module->GetOSModule(), nullptr);
        EXPECT_EQ(module->CreateAudioFilter(MemberID(test.mName)), nullptr) << "not loaded yet";
        ASSERT_TRUE(module->Load());
        EXPECT_NE(module->GetOSModule(), nullptr);
        EXPECT_FALSE(module->Load()) << "a second load is refused";
        EXPECT_TRUE(recorder.Calls().empty()) << "nothing is entered before there is a reason";
        EXPECT_NE(module->CreateAudioFilter(MemberID(test.mName)), nullptr);
        EXPECT_EQ(recorder.Calls().front(), test.mEntry);
    }
}

TEST_F(VSTPluginModuleTest, UnloadKeepsTheEntryPoint)
{
    const ModulePtr module(new VSTPluginModule(PathOf(VST2Fixture("Normal"))));
    module->Unload();
    ASSERT_TRUE(module->Load());
    module->Unload();
    EXPECT_EQ(module->GetOSModule(), nullptr);
    EXPECT_NE(module->CreateAudioFilter(MemberID("Normal")), nullptr);
    EXPECT_TRUE(module->Load());
}

TEST_F(VSTPluginModuleTest, SaysWhatCannotBeLoaded)
{
    struct Case
    {
        const char* mName;
        const char* mProblem; // after the path
    };
    const Case cases[] = {
        {"Helper", " is not a VST 2 plug-in: it exports no entry point such as VSTPluginMain."},
        {"Nowhere", " does not exist."},
    };
    for (const Case& test : cases)
    {
        const auto path = VST2Fixture(test.mName);
        EXPECT_EQ(GetVSTPlugin(PathOf(path)), nullptr);
        EXPECT_EQ(ProblemOf(path), "\"" + path.string() + "\"" + test.mProblem);
    }
    const TempFolder folder;
    folder.Write("Text.so", "text");
    EXPECT_EQ(GetVSTPlugin(PathOf(folder.Path("Text.so"))), nullptr);
    EXPECT_EQ(ProblemOf(folder.Path("Text.so")),
              "\"" + folder.Path("Text.so").string() + "\" is not a shared library.");
}

TEST_F(VSTPluginModuleTest, BundlesOfAllForms)
{
    for (const char* name : {"Bundled", "Flat", "Suffixed"})
    {
        const auto path = VST2Fixture(name);
        ASSERT_EQ(path.extension(), ".vst");
        std::vector<UTF16String> ids;
        const ModulePtr module = GetVSTPlugin(PathOf(path));
        ASSERT_NE(module, nullptr) << ProblemOf(path);
        const auto info = module->GetPluginInfo(ids);
        ASSERT_NE(info, nullptr);
        EXPECT_TRUE(ids == std::vector{MemberID(name)});
    }
    const TempFolder folder;
    std::filesystem::create_directories(folder.Path("Win.vst/Contents/x86_64-win"));
    EXPECT_EQ(GetVSTPlugin(PathOf(folder.Path("Win.vst"))), nullptr);
    EXPECT_NE(ProblemOf(folder.Path("Win.vst")).find("x86_64-win"), std::string::npos);
}

TEST_F(VSTPluginModuleTest, OneModuleForEachPath)
{
    const UTF16String path = PathOf(VST2Fixture("Normal"));
    const ModulePtr module = GetVSTPlugin(path);
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(GetVSTPlugin(path), module);
    module->Unload();
    EXPECT_EQ(GetVSTPlugin(path), module);
    EXPECT_NE(module->GetOSModule(), nullptr) << "loaded again";
}

TEST_F(VSTPluginModuleTest, DescribesBinaries)
{
    struct Case
    {
        const char* mName;
        bool mHasInfo;
        std::size_t mEffects;
        bool mIsShell = false;
        const char* mProblem = ""; // after the path
    };
    const Case cases[] = {
        {"Normal", true, 1},
        {"Version2300", true, 1},
        {"Version2299", false, 0, false, " is made for an interface older than VST 2.3."},
        {"NullEntry", false, 0, false, " refuses to work: its entry function gives no plug-in."},
        {"WrongMagic", false, 0, false, " is not a VST 2 plug-in: its entry function gives something else."},
        {"Synth", true, 0},
        {"Shell", true, 3, true},
        {"MixedShell", true, 3, true},
        {"EmptyShell", true, 0, true},
        {"ThrowsInDispatcher", true, 1},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mName);
        const auto path = VST2Fixture(test.mName);
        const auto recorder = RecorderOf(path);
        const int living = recorder.LiveObjects();
        const ModulePtr module = GetVSTPlugin(PathOf(path));
        ASSERT_NE(module, nullptr);
        std::vector<UTF16String> ids = {u"old", u"older", u"oldest", u"ancient"};
        const auto info = module->GetPluginInfo(ids);
        EXPECT_EQ(ids.size(), test.mEffects);
        for (std::size_t member = 0; member < ids.size(); ++member)
            EXPECT_TRUE(ids[member] == MemberID(test.mName, static_cast<unsigned int>(member)));
        const bool isKept = std::string_view(test.mName) == "WrongMagic"; // nobody knows how to give it back
        EXPECT_EQ(recorder.LiveObjects(), living + (isKept ? 1 : 0));
        EXPECT_EQ(ProblemOf(path), *test.mProblem ? "\"" + path.string() + "\"" + test.mProblem : "");
        ASSERT_EQ(info != nullptr, test.mHasInfo);
        if (!info)
            continue;
        EXPECT_TRUE(info->GetLocator() == PluginLocator(kTechnologyVST, PathOf(path)));
        EXPECT_EQ(info->GetType(), kTechnologyVST);
        EXPECT_EQ(info->GetVersion(), std::string_view(test.mName) == "Version2300" ? 2300U : 2400U);
        EXPECT_TRUE(info->IsEnabled());
        EXPECT_EQ(info->IsShell(), test.mIsShell);
        EXPECT_FALSE(info->HasAnyNonSynthEffect()) << "only the scan can tell";
    }
}

TEST_F(VSTPluginModuleTest, NamesAndMakers)
{
    struct Case
    {
        const char* mName;
        const char16_t* mEffect;
        const char16_t* mVendor;
    };
    const Case cases[] = {
        {"Normal", u"Normal", u"Zeb Fixtures"}, {"EmptyName", u"EmptyName", u""}, // the file's title
    };
    for (const Case& test : cases)
    {
        std::vector<UTF16String> ids;
        const auto info = LoadFixture(test.mName)->GetPluginInfo(ids);
        ASSERT_NE(info, nullptr);
        EXPECT_TRUE(info->GetName() == test.mEffect);
        EXPECT_TRUE(info->GetVendor() == test.mVendor);
    }
}

TEST_F(VSTPluginModuleTest, OpensAsksAndClosesOnce)
{
    const auto recorder = RecorderOf(VST2Fixture("Shell"));
    const ModulePtr module = LoadFixture("Shell");
    ASSERT_NE(module, nullptr);
    VSTAudioFilter::SetCurrentFilterID(99);
    recorder.Clear();
    std::vector<UTF16String> ids;
    module->GetPluginInfo(ids);
    EXPECT_EQ(recorder.CallsTo("entry"), (Texts{"entry.audioMasterCurrentId -> 0"}));
    EXPECT_EQ(recorder.Count("effOpen"), 1U);
    EXPECT_EQ(recorder.Count("effGetVstVersion"), 1U);
    EXPECT_EQ(recorder.Count("effShellGetNextPlugin"), 4U);
    EXPECT_EQ(recorder.Count("effClose"), 1U);
    EXPECT_EQ(recorder.Calls().back(), "effClose");
}

TEST_F(VSTPluginModuleTest, WhatIsThrownAtTheVersionPassesThrough)
{
    const auto recorder = RecorderOf(VST2Fixture("ThrowsInVersion"));
    const ModulePtr module = LoadFixture("ThrowsInVersion");
    ASSERT_NE(module, nullptr);
    std::vector<UTF16String> ids;
    EXPECT_THROW(module->GetPluginInfo(ids), std::runtime_error);
    EXPECT_EQ(recorder.LiveObjects(), 0) << "the instance does not stay";
}

TEST_F(VSTPluginModuleTest, WhatIsThrownAtTheEntryPassesThroughAndIsTold)
{
    const auto path = zebtest::VST2Hazard("ThrowInEntry");
    const ModulePtr module = GetVSTPlugin(PathOf(path));
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(ProblemOf(path), "");
    EXPECT_THROW(module->CreateAudioFilter(u"2:1"), std::runtime_error);
    EXPECT_EQ(ProblemOf(path), "\"" + path.string() + "\" refuses to work: its entry function throws.");
}

TEST_F(VSTPluginModuleTest, AFilterThatIsMadeEndsTheProblem)
{
    const auto path = VST2Fixture("Normal");
    const auto recorder = RecorderOf(path);
    const ModulePtr module = LoadFixture("Normal");
    recorder.Set("entryNull", 1);
    EXPECT_EQ(module->CreateAudioFilter(MemberID("Normal")), nullptr);
    EXPECT_NE(ProblemOf(path), "");
    recorder.Reset();
    EXPECT_NE(module->CreateAudioFilter(MemberID("Normal")), nullptr);
    EXPECT_EQ(ProblemOf(path), "");
}

// There is no plug-in to ask.
TEST_F(VSTPluginModuleTest, WithoutAnEntryPointThereAreNoIDs)
{
    const ModulePtr module(new VSTPluginModule(PathOf(VST2Fixture("Normal"))));
    std::vector<UTF16String> ids = {u"old"};
    EXPECT_EQ(module->GetPluginInfo(ids), nullptr);
    EXPECT_TRUE(ids.empty());
}

TEST_F(VSTPluginModuleTest, TracesAnOldVersion)
{
    std::string lines;
    zebcore::debug::SetTraceSink([&lines](std::string_view line) { lines += line; });
    zebcore::debug::SetTraceCategoryEnabled("VSTPluginModule::EnumerateFilters", true);
    std::vector<UTF16String> ids;
    LoadFixture("Version2299")->GetPluginInfo(ids);
    LoadFixture("Version2300")->GetPluginInfo(ids);
    zebcore::debug::SetAllTraceEnabled(false);
    zebcore::debug::SetTraceSink({});
    const std::string wanted = "<VSTPluginModule::EnumerateFilters> <6> version < kVstMinVersion: 2299\n";
    ASSERT_GE(lines.size(), wanted.size()) << lines;
    EXPECT_EQ(lines.substr(lines.size() - wanted.size()), wanted);
    EXPECT_EQ(lines.find("kVstMinVersion"), lines.rfind("kVstMinVersion"));
}

TEST_F(VSTPluginModuleTest, HonoursThePermanentBlockList)
{
    struct Case
    {
        const char* mName;
        std::string mEntry;
        bool mHasInfo;
    };
    const std::string id = std::to_string(VST2FixtureID("ListedEffect"));
    const Case cases[] = {
        {"ListedEffect", "filename=\"LISTEDEFFECT.so\"", false},
        {"ListedEffect", "filename=\"ListedEffect.so\" uniqueid=\"" + id + "\"", false},
        {"ListedEffect", "filename=\"ListedEffect.so\" uniqueid=\"" + id + "\" version=\"2400\"", false},
        {"ListedEffect", "filename=\"ListedEffect.so\" uniqueid=\"1" + id + "\"", true},
        {"ListedEffect", "filename=\"ListedEffect.so\" version=\"2401\"", true},
        {"ListedSynth", "filename=\"ListedSynth.so\"", true},
    };
    for (const Case& test : cases)
    {
        SCOPED_TRACE(test.mEntry);
        const PermanentList list("<plugin " + test.mEntry + "/>");
        const ModulePtr module = LoadFixture(test.mName);
        ASSERT_NE(module, nullptr);
        std::vector<UTF16String> ids = {u"old"};
        EXPECT_EQ(module->GetPluginInfo(ids) != nullptr, test.mHasInfo);
        EXPECT_EQ(ids.empty(), !test.mHasInfo || std::string_view(test.mName) == "ListedSynth");
        const std::string problem = ProblemOf(VST2Fixture(test.mName));
        EXPECT_EQ(problem.find("permanent block list") != std::string::npos, !test.mHasInfo) << problem;
    }
}

TEST_F(VSTPluginModuleTest, MakesTheMemberThatTheIDNames)
{
    const auto recorder = RecorderOf(VST2Fixture("Shell"));
    const ModulePtr module(new VSTPluginModule(PathOf(VST2Fixture("Shell"))));
    ASSERT_TRUE(module->Load());
    recorder.Clear();
    EXPECT_TRUE(module->CreateAudioFilter(MemberID("Shell", 1))->GetDisplayName() == u"Shell")
        << "that it is a shell is not known yet";
    std::vector<UTF16String> ids;
    module->GetPluginInfo(ids);
    ASSERT_EQ(ids.size(), 3U);
    recorder.Clear();
    const auto filter = module->CreateAudioFilter(ids[2]);
    ASSERT_NE(filter, nullptr);
    EXPECT_TRUE(filter->GetID() == ids[2]);
    EXPECT_TRUE(filter->GetDisplayName() == u"Third Member");
    EXPECT_EQ(recorder.CallsTo("entry"),
              (Texts{"entry.audioMasterCurrentId -> " + std::to_string(VST2FixtureID("Shell") + 2)}));
    EXPECT_EQ(module->CreateAudioFilter(MemberID("Shell", 3)), nullptr) << "there is no such member";
    recorder.Clear();
    const auto shell = module->CreateAudioFilter(u"2:no number");
    ASSERT_NE(shell, nullptr);
    EXPECT_TRUE(shell->GetID() == u"2:0 Shell");
    EXPECT_EQ(recorder.CallsTo("entry"), (Texts{"entry.audioMasterCurrentId -> 0"}));
}

TEST_F(VSTPluginModuleTest, AnEffectIsCalledLikeItsFile)
{
    const auto filter = LoadFixture("EmptyName")->CreateAudioFilter(MemberID("EmptyName"));
    ASSERT_NE(filter, nullptr);
    EXPECT_TRUE(filter->GetDisplayName() == u"EmptyName");
    const auto gain = GetVSTPlugin(PathOf(VST2Effect("ZebGain2")));
    ASSERT_NE(gain, nullptr);
    EXPECT_TRUE(gain->CreateAudioFilter(u"2:1")->GetDisplayName() == u"ZebGain2");
    EXPECT_EQ(CreateAudioFilter(MemberID("Normal")), nullptr) << "nothing in the catalogue has this ID yet";
}

} // namespace

} // namespace zebaudiofilterhost::vst
