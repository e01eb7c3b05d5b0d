// Where zebhost looks for plug-ins, and what it takes for one.
#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::ElementsAre;
using testing::HasSubstr;

class PluginPlacesTest : public ZebhostTest
{
protected:
    PluginPlacesTest()
    {
        SearchIn(mFolder / "none");
        for (const char* folder : {"first", "second", "mixed/One.lv2", "mixed/Two.clap", "mixed/deeper"})
        {
            fs::create_directories(mFolder / folder);
        }
    }

    void Copy(std::string_view fixture, const std::string& target) const
    {
        fs::copy_file(BinaryOf(VST2Fixture(fixture)), mFolder / target);
    }

    // The file names of what would be scanned.
    std::vector<std::string> Planned(std::vector<std::string> paths) const
    {
        paths.insert(paths.begin(), {"scan", "--dry-run", "--json"});
        std::vector<std::string> names;
        const nlohmann::json document = Succeed(paths).Json();
        for (const nlohmann::json& plugin : document.at("plugins"))
        {
            names.push_back(fs::path(plugin.at("path").get<std::string>()).filename().string());
        }
        return names;
    }
};

TEST_F(PluginPlacesTest, TheEnvironmentOfTheDayCounts)
{
    Copy("Normal", "first/Early.so");
    Copy("Normal", "second/Late.so");
    mVariables["VST_PATH"] = Path("first");
    Succeed({"scan", "--quiet"});
    mVariables["VST_PATH"] = Path("second");
    EXPECT_THAT(Planned({}), ElementsAre("Late.so")) << "the first folder stands in the settings";
}

TEST_F(PluginPlacesTest, OfAFolderOnlyThePluginsAndEachOnce)
{
    Copy("Normal", "mixed/Normal.so");
    Copy("Bundled", "mixed/deeper/Deep.so");
    Copy("Helper", "mixed/Helper.so");
    Copy("Normal", "mixed/One.lv2/One.so");
    Copy("Normal", "mixed/Two.clap/Two.so");
    WriteText(mFolder / "mixed/Text.so", "text");
    fs::create_symlink("Normal.so", mFolder / "mixed/Same.so");
    EXPECT_THAT(Planned({Path("mixed")}), ElementsAre("Normal.so", "Deep.so"));
    EXPECT_THAT(Planned({Path("mixed"), Path("mixed/Helper.so")}), ElementsAre("Normal.so", "Deep.so", "Helper.so"))
        << "what is asked for by name is tried";
}

TEST_F(PluginPlacesTest, SaysWhatAPluginIsCalled)
{
    WriteText(mFolder / "Effect.dll", "text");
    for (const char* command : {"scan", "info", "block"})
    {
        EXPECT_THAT(Run({command, Path("Effect.dll")}).LastLine(), HasSubstr(".vst3, .vst, .component or .so"))
            << command;
    }
}

} // namespace

} // namespace zebtest
