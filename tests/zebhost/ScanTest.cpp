#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;
using testing::UnorderedElementsAre;

class ScanTest : public ZebhostTest
{
protected:
    // The state of each plug-in of a scan's document, by file name.
    static std::map<std::string, std::string> States(const nlohmann::json& document)
    {
        std::map<std::string, std::string> states;
        for (const nlohmann::json& plugin : document.at("plugins"))
        {
            states[fs::path(plugin.at("path").get<std::string>()).filename().string()] = plugin.at("state");
        }
        return states;
    }

    std::vector<std::string> Names() const
    {
        std::vector<std::string> names;
        const nlohmann::json document = Succeed({"list", "--json"}).Json();
        for (const nlohmann::json& filter : document.at("filters"))
        {
            names.push_back(filter.at("name"));
        }
        return names;
    }

    // A folder of links to bundles.
    fs::path LinkFolder(const std::vector<fs::path>& bundles) const
    {
        const fs::path folder = mFolder / "links";
        fs::create_directories(folder);
        for (const fs::path& bundle : bundles)
        {
            fs::create_directory_symlink(bundle, folder / bundle.filename());
        }
        return folder;
    }
};

TEST_F(ScanTest, PutsEffectsIntoTheCatalogueAndInstrumentsNot)
{
    const RunResult result = Succeed({"scan"});
    EXPECT_THAT(result.LastLine(), HasSubstr("5 plug-ins scanned, 6 effects found"));
    EXPECT_THAT(Names(), UnorderedElementsAre("Zeb Balance", "Zeb Compressor", "Zeb Delay", "Zeb Gain", "Zeb Tilt",
                                              "Zeb Tremolo"));
}

TEST_F(ScanTest, LoadsNothingThatIsInTheCatalogueAlready)
{
    Succeed({"scan"});
    const RunResult again = Succeed({"scan", "--trace", "VST3PluginModule::Load"});
    EXPECT_THAT(again.err, Not(HasSubstr("<VST3PluginModule::Load>")));
    EXPECT_THAT(again.LastLine(), HasSubstr("nothing to scan"));
    EXPECT_EQ(States(Succeed({"scan", "--full", "--json"}).Json()).size(), 5U);
}

TEST_F(ScanTest, DryRunTellsWhatWouldHappenAndDoesNothing)
{
    const nlohmann::json document = Succeed({"scan", "--dry-run", "--json"}).Json();
    EXPECT_EQ(States(document).at("ZebGain.vst3"), "would-scan");
    EXPECT_EQ(document.at("plugins").at(0).at("reason"), "new");
    EXPECT_FALSE(fs::exists(CatalogueFile()));
}

TEST_F(ScanTest, DropsWhatHasGoneAndKeepsWhatLiesElsewhere)
{
    const fs::path copy = mFolder / "copies" / "ZebGain.vst3";
    fs::create_directories(copy.parent_path());
    fs::copy(EffectBundle("ZebGain"), copy, fs::copy_options::recursive);
    SearchIn(mFolder / "empty");
    Succeed({"scan", copy.string()});
    Succeed({"scan"});
    EXPECT_THAT(Names(), UnorderedElementsAre("Zeb Gain"));
    fs::remove_all(copy);
    EXPECT_EQ(States(Succeed({"scan", "--json"}).Json()).at("ZebGain.vst3"), "dropped");
    EXPECT_THAT(Names(), UnorderedElementsAre());
}

TEST_F(ScanTest, ListsABundleOnceThatALinkReachesAgain)
{
    fs::create_directories(mFolder / "links");
    fs::create_directory_symlink(EffectBundle("ZebGain"), mFolder / "links" / "Other Name.vst3");
    SearchIn(EffectFolder().string() + ":" + (mFolder / "links").string());
    Succeed({"scan"});
    const std::vector<std::string> names = Names();
    EXPECT_EQ(std::count(names.begin(), names.end(), "Zeb Gain"), 1);
}

TEST_F(ScanTest, APathMayBeAFolderABundleOrNothing)
{
    EXPECT_EQ(States(Succeed({"scan", EffectFolder().string(), "--json"}).Json()).size(), 5U);
    EXPECT_EQ(States(Succeed({"scan", EffectBundle("ZebTrio").string() + "/", "--json"}).Json()).size(), 1U);
    const RunResult nothing = Run({"scan", Path("Nothing.vst3")});
    EXPECT_EQ(nothing.code, 3);
    EXPECT_THAT(nothing.LastLine(), HasSubstr(Path("Nothing.vst3")));
    WriteText(Path("file.txt"), "no plug-in");
    EXPECT_EQ(Run({"scan", Path("file.txt")}).code, 3);
    fs::create_directories(mFolder / "empty");
    EXPECT_THAT(Succeed({"scan", Path("empty")}).LastLine(),
                testing::AllOf(HasSubstr(Path("empty")), Not(HasSubstr("--full"))));
    fs::create_symlink("loop", mFolder / "loop");
    const RunResult unreadable = Run({"scan", Path("loop")});
    EXPECT_EQ(unreadable.code, 7);
    EXPECT_THAT(unreadable.LastLine(), HasSubstr("cannot be read"));
}

TEST_F(ScanTest, TellsWhyANamedBundleCouldNotBeLoaded)
{
    for (const char* name :
         {"NoFactory", "NullFactory", "NoClasses", "EmptyBundle", "WindowsOnly", "OtherArchitecture", "NotABinary"})
    {
        const RunResult result = Run({"scan", FixtureBundle(name).string()});
        EXPECT_EQ(result.code, 4) << name << ": " << result.err;
        EXPECT_THAT(result.LastLine(), HasSubstr(std::string(name) + ".vst3")) << name;
    }
    EXPECT_THAT(Run({"scan", FixtureBundle("WindowsOnly").string()}).LastLine(), HasSubstr("x86_64-win"));
}

TEST_F(ScanTest, AFolderOfBadPluginsIsScannedToItsEnd)
{
    const RunResult result = Run({"scan", FixtureFolder().string(), "--json"});
    ASSERT_EQ(result.code, 0) << result.err;
    const std::map<std::string, std::string> states = States(result.Json());
    EXPECT_EQ(states.at("NoFactory.vst3"), "failed");
    EXPECT_EQ(states.at("Normal.vst3"), "scanned");
    EXPECT_EQ(states.at("WritesParameters.vst3"), "scanned");
    EXPECT_EQ(Succeed({"blocks", "--json"}).Json().at("blocked").size(), 0U);
}

TEST_F(ScanTest, NamesOfOddUnitsArePrintedWithoutPaddingAndStayValid)
{
    Succeed({"scan", FixtureFolder().string(), "--quiet"});
    const RunResult list = Succeed({"list", "--json"});
    EXPECT_EQ(list.out.find("\\u0000"), std::string::npos);
    EXPECT_EQ(list.out.find('\0'), std::string::npos);
    EXPECT_FALSE(list.Json().at("filters").empty());
    const RunResult table = Succeed({"list", "--long"});
    EXPECT_TRUE(std::none_of(table.out.begin(), table.out.end(),
                             [](char letter)
                             { return letter != '\n' && static_cast<unsigned char>(letter) < 0x20; }));
}

TEST_F(ScanTest, LeavesBlockedPluginsAlone)
{
    SearchIn(LinkFolder({EffectBundle("ZebGain"), EffectBundle("ZebDelay")}));
    Succeed({"scan"});
    Succeed({"block", "Zeb Gain", "--reason", "too loud"});
    EXPECT_EQ(States(Succeed({"scan", "--json"}).Json()).at("ZebGain.vst3"), "dropped");
    EXPECT_THAT(Names(), UnorderedElementsAre("Zeb Delay"));
    const RunResult named = Run({"scan", (mFolder / "links" / "ZebGain.vst3").string()});
    EXPECT_EQ(named.code, 6);
    EXPECT_THAT(named.LastLine(), HasSubstr("too loud"));
    Succeed({"unblock", "ZebGain.vst3"});
    Succeed({"scan"});
    EXPECT_THAT(Names(), UnorderedElementsAre("Zeb Delay", "Zeb Gain"));
}

TEST_F(ScanTest, TriesWhatWasUnblockedWhereverItLies)
{
    const fs::path folder = LinkFolder({EffectBundle("ZebGain"), HazardBundle("CrashInEntry")});
    SearchIn(mFolder / "none");
    EXPECT_EQ(States(Succeed({"scan", folder.string(), "--json"}).Json()).at("CrashInEntry.vst3"), "crashed");
    Succeed({"block", "ZebGain.vst3"});
    EXPECT_EQ(States(Succeed({"scan", "--json"}).Json()).at("ZebGain.vst3"), "dropped");
    EXPECT_EQ(Succeed({"blocks", "--names"}).out, "CrashInEntry.vst3\nZebGain.vst3\n");
    for (const char* name : {"ZebGain", "CrashInEntry.vst3"})
    {
        EXPECT_THAT(Succeed({"unblock", name}).LastLine(), HasSubstr("the next 'zebhost scan' tries it"));
    }
    EXPECT_THAT(Succeed({"scan", "--dry-run"}).out, HasSubstr("was unblocked"));
    const std::map<std::string, std::string> states = States(Succeed({"scan", "--json"}).Json());
    EXPECT_EQ(states.at("ZebGain.vst3"), "scanned");
    EXPECT_EQ(states.at("CrashInEntry.vst3"), "crashed");
    EXPECT_THAT(Names(), UnorderedElementsAre("Zeb Gain"));
    EXPECT_THAT(Succeed({"scan"}).LastLine(), HasSubstr("nothing to scan, 1 blocked before"));
}

TEST_F(ScanTest, ThePermanentListKeepsPluginsOut)
{
    WriteText(Settings() / "PermanentAudioPlugInBlacklist.xml",
              "<pluginlist><plugin filename=\"zebgain.VST3\"/></pluginlist>");
    Succeed({"scan"});
    EXPECT_THAT(Names(), Not(testing::Contains("Zeb Gain")));
    EXPECT_EQ(Run({"info", EffectBundle("ZebGain").string()}).code, 6);
}

} // namespace

} // namespace zebtest
