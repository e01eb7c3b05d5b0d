#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;

class SettingsFilesTest : public ZebhostTest
{
protected:
    // The one file of the settings folder whose name begins like this.
    std::string Aside(const std::string& beginning) const
    {
        for (const fs::directory_entry& entry : fs::directory_iterator(Settings()))
        {
            if (entry.path().filename().string().find(beginning + ".damaged-") == 0)
            {
                return ReadText(entry.path());
            }
        }
        return "none";
    }
};

TEST_F(SettingsFilesTest, ADamagedCatalogueIsKeptAsideBeforeANewOneIsSaved)
{
    for (const char* damage : {"<not a list", "", "plain words"})
    {
        WriteText(CatalogueFile(), damage);
        const RunResult listed = Succeed({"list"});
        EXPECT_THAT(listed.err, HasSubstr("is damaged")) << damage;
        EXPECT_EQ(ReadText(CatalogueFile()), damage) << "a command that saves nothing must change nothing";
        const RunResult scanned = Succeed({"scan"});
        EXPECT_THAT(scanned.err, HasSubstr("kept as"));
        EXPECT_EQ(Aside("AudioPluginManagerSettings.xml"), damage);
        EXPECT_EQ(Succeed({"list", "--json"}).Json().at("filters").size(), 6U);
        fs::remove_all(Settings());
    }
}

TEST_F(SettingsFilesTest, ACatalogueOfAnotherVersionIsKeptAsideToo)
{
    Succeed({"scan", "--quiet"});
    std::string text = ReadText(CatalogueFile());
    const std::size_t version = text.find(">2<");
    ASSERT_NE(version, std::string::npos) << text.substr(0, 300);
    text.replace(version, 3, ">3<");
    WriteText(CatalogueFile(), text);
    Succeed({"scan"});
    EXPECT_EQ(Aside("AudioPluginManagerSettings.xml"), text);
}

TEST_F(SettingsFilesTest, ADamagedBlockListIsKeptAside)
{
    WriteText(Settings() / "DynamicAudioPlugInBlacklist.xml", "<broken");
    EXPECT_THAT(Succeed({"blocks"}).err, HasSubstr("is damaged"));
    Succeed({"block", EffectBundle("ZebGain").string()});
    EXPECT_EQ(Aside("DynamicAudioPlugInBlacklist.xml"), "<broken");
    EXPECT_EQ(Succeed({"blocks", "--json"}).Json().at("blocked").size(), 1U);
}

TEST_F(SettingsFilesTest, LosingTheReasonsLosesNothingElse)
{
    Succeed({"block", EffectBundle("ZebGain").string(), "--reason", "loud"});
    for (const char* text : {"{", "[]", "{\"version\":1,\"blocked\":{\"3:x\":7}}", "{\"version\":9}"})
    {
        WriteText(Settings() / "DynamicAudioPlugInBlacklist.reasons.json", text);
        const nlohmann::json blocked = Succeed({"blocks", "--json"}).Json().at("blocked");
        ASSERT_EQ(blocked.size(), 1U) << text;
        EXPECT_EQ(blocked.at(0).at("reason"), "") << text;
    }
}

TEST_F(SettingsFilesTest, DamagedTablesAreToldOfAndKeptAside)
{
    const std::vector<std::pair<std::string, std::vector<std::string>>> tables = {
        {"DynamicAudioPlugInBlacklist.reasons.json", {"block", "Zeb Delay"}},
        {"AudioPluginManagerSettings.binaries.json", {"scan", "--full"}}};
    for (const auto& [name, saving] : tables)
    {
        for (const char* damage : {"garbage", "", "{\"version\":9}", "{\"version\":1,\"blocked\":{\"3:x\":7}}"})
        {
            fs::remove_all(Settings());
            Succeed({"scan"});
            Succeed({"block", "Zeb Gain", "--reason", "why"});
            WriteText(Settings() / name, damage);
            EXPECT_THAT(Succeed({"blocks"}).err, HasSubstr(name + " is damaged")) << damage;
            EXPECT_EQ(ReadText(Settings() / name), damage) << "a command that saves nothing must change nothing";
            EXPECT_THAT(Succeed(saving).err, HasSubstr("kept as")) << damage;
            EXPECT_EQ(Aside(name), damage);
            EXPECT_EQ(Succeed({"blocks"}).err, "") << damage;
        }
    }
}

TEST_F(SettingsFilesTest, APlaceThatCannotBeWrittenIsTold)
{
    WriteText(mFolder / "settings", "a file where the folder should be");
    const RunResult result = Run({"scan"});
    EXPECT_EQ(result.code, 7);
    EXPECT_THAT(result.LastLine(), HasSubstr("--settings"));
}

TEST_F(SettingsFilesTest, APlaceThatCannotBeReadIsTold)
{
    fs::create_symlink("settings", mFolder / "settings");
    for (const char* command : {"list", "blocks", "scan"})
    {
        const RunResult result = Run({command});
        EXPECT_EQ(result.code, 7) << command;
        EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr("settings"), HasSubstr("readable"))) << command;
    }
}

TEST_F(SettingsFilesTest, WithoutSettingsThePreferenceFolderIsUsed)
{
    mVariables["XDG_CONFIG_HOME"] = Path("config");
    ASSERT_EQ(RunProgram({ZEBHOST_PROGRAM, "scan", "--quiet"}, mVariables, mFolder).code, 0);
    EXPECT_TRUE(fs::exists(mFolder / "config" / "zebaudiofilterhost" / "AudioPluginManagerSettings.xml"));
}

} // namespace

} // namespace zebtest
