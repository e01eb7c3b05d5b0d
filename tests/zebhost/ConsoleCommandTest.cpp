#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

const std::string kBuild = "zebaudiofilterhost.BuildPrivatePluginConfig";

class ConsoleCommandTest : public ZebhostTest
{
protected:
    // The plug-ins of an application's own folder, in a place with all that a shell and XML trip over.
    std::string ShipEffects(std::initializer_list<const char*> names) const
    {
        const fs::path folder = mFolder /
                                "R&D's \"Gr\xc3\xb6\xc3\x9f"
                                "e\" <\xe9\x9f\xb3>" /
                                "Plug Ins";
        fs::create_directories(folder);
        for (const char* const name : names)
        {
            fs::copy(EffectBundle(name), folder / EffectBundle(name).filename(), fs::copy_options::recursive);
        }
        return folder.string();
    }
};

TEST_F(ConsoleCommandTest, ListsTheCommandsWithTheirHelp)
{
    EXPECT_THAT(Succeed({"console"}).out,
                HasSubstr(kBuild + "  Build the private plug-in configuration used by zebaudiofilterhost.\n"));
    EXPECT_EQ(Succeed({"console", "--names"}).out, kBuild + "\n");
    const nlohmann::json commands = Succeed({"console", "--json"}).Json().at("commands");
    ASSERT_EQ(commands.size(), 1U);
    EXPECT_EQ(commands.at(0).at("name"), kBuild);
    EXPECT_EQ(commands.at(0).at("description"),
              "Build the private plug-in configuration used by zebaudiofilterhost.");
}

TEST_F(ConsoleCommandTest, AnUnknownNameIsNotFound)
{
    for (const char* const name : {"nothing", "zebaudiofilterhost.buildprivatepluginconfig", " ", "\xff"})
    {
        const RunResult result = Run({"console", name, "x,y"});
        EXPECT_EQ(result.code, 3) << name;
        EXPECT_EQ(result.out, "") << name;
        EXPECT_THAT(result.LastLine(), HasSubstr("'zebhost console' lists them")) << name;
    }
}

TEST_F(ConsoleCommandTest, BuildsThePrivateConfigurationAndLeavesTheUsersCatalogueAlone)
{
    Succeed({"scan", EffectBundle("ZebDelay").string(), "--quiet"});
    const std::string catalogue = ReadText(CatalogueFile());
    const std::string folder = ShipEffects({"ZebGain", "ZebTrio"});
    const std::string result = Path("Private Plugin Config");

    EXPECT_EQ(Succeed({"console", kBuild, result + "," + folder}).out, "Done.\n");
    const std::string text = ReadText(result);
    EXPECT_THAT(text, HasSubstr("@VST3PRIVATEAPPLICATIONPLUGINPATH/ZebGain.@VST3PLUGINEXTENSION"));
    EXPECT_THAT(text, HasSubstr("Zeb Tremolo"));
    EXPECT_THAT(text, Not(HasSubstr("Zeb Delay")));
    EXPECT_THAT(text, Not(HasSubstr("Plug Ins")));
    EXPECT_EQ(ReadText(CatalogueFile()), catalogue);

    // Words of the shell reach the command as one text.
    fs::remove(result);
    const nlohmann::json document =
        Succeed({"console", "--json", kBuild, Path("Private"), "Plugin", "Config," + folder}).Json();
    EXPECT_EQ(document.at("name"), kBuild);
    EXPECT_EQ(document.at("output"), "Done.\n");
    EXPECT_EQ(ReadText(result), text);
}

TEST_F(ConsoleCommandTest, PrintsWhatTheCommandSaysOfItsUse)
{
    for (const std::vector<std::string>& line :
         {std::vector<std::string>{"console", kBuild}, std::vector<std::string>{"console", kBuild, Path("x")}})
    {
        EXPECT_EQ(Succeed(line).out, kBuild + " <path of result file>,<VST3 directory>,[VST2 directory]\n");
        EXPECT_THAT(Files(), testing::IsEmpty());
    }
}

TEST_F(ConsoleCommandTest, FailuresOfTheCommandAreToldInTheUsualWay)
{
    const RunResult unwritable = Run({"console", kBuild, Path("no/such/folder/x") + "," + EffectFolder().string()});
    EXPECT_EQ(unwritable.code, 7);
    EXPECT_EQ(unwritable.out, "");
    EXPECT_THAT(unwritable.LastLine(), HasSubstr("no/such/folder/x"));

    WriteText(Path("result"), "the old one");
    const fs::path hazard = HazardBundle("CrashInEntry");
    fs::create_directories(mFolder / "Plug-Ins");
    fs::create_directory_symlink(hazard, mFolder / "Plug-Ins" / hazard.filename());
    const RunResult crashed = Run({"console", kBuild, Path("result") + "," + Path("Plug-Ins")});
    EXPECT_EQ(crashed.code, 5);
    EXPECT_THAT(crashed.LastLine(), StartsWith("zebhost: the console command " + kBuild + " crashed: "));
    EXPECT_EQ(ReadText(Path("result")), "the old one");
}

} // namespace

} // namespace zebtest
