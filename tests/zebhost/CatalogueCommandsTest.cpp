#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

using testing::HasSubstr;

constexpr const char* kGainID = "3:5a656247 61696e00 10000000 1";

class CatalogueCommandsTest : public ZebhostTest
{
protected:
    std::string NameOf(const std::string& filter) const
    {
        const RunResult result = Run({"info", filter, "--json"});
        return result.code == 0 ? result.Json().at("filter").at("name").get<std::string>()
                                : "code " + std::to_string(result.code);
    }
};

TEST_F(CatalogueCommandsTest, AFilterIsAnIDANameOrThePathOfABundle)
{
    Succeed({"scan", "--quiet"});
    EXPECT_EQ(NameOf(kGainID), "Zeb Gain");
    EXPECT_EQ(NameOf("Zeb Gain"), "Zeb Gain");
    EXPECT_EQ(NameOf("zeb gain"), "Zeb Gain");
    EXPECT_EQ(NameOf("Zeb G"), "Zeb Gain");
    EXPECT_EQ(NameOf("gain"), "Zeb Gain");
    EXPECT_EQ(NameOf(EffectBundle("ZebGain").string()), "Zeb Gain");
    EXPECT_EQ(NameOf(EffectBundle("ZebTrio").string() + "#Zeb Tilt"), "Zeb Tilt");
    EXPECT_EQ(NameOf(EffectBundle("ZebTrio").string() + "#tilt"), "Zeb Tilt");
    EXPECT_EQ(NameOf("3:0 0 0 0"), "code 3");
    EXPECT_EQ(NameOf(Path("Nothing.vst3")), "code 3");
    EXPECT_EQ(NameOf(Path("Nothing")), "code 3");
}

TEST_F(CatalogueCommandsTest, ABundleNeedsNoScanAndLeavesNoTrace)
{
    EXPECT_EQ(NameOf(EffectBundle("ZebGain").string()), "Zeb Gain");
    EXPECT_FALSE(std::filesystem::exists(CatalogueFile()));
    EXPECT_FALSE(std::filesystem::exists(Settings()));
}

TEST_F(CatalogueCommandsTest, ATieNamesTheCandidates)
{
    Succeed({"scan", "--quiet"});
    const RunResult names = Run({"info", "Zeb", "--json"});
    EXPECT_EQ(names.code, 3);
    EXPECT_EQ(names.Json().at("error").at("details").size(), 6U);
    EXPECT_THAT(names.err, HasSubstr(kGainID));
    const RunResult classes = Run({"info", EffectBundle("ZebTrio").string()});
    EXPECT_EQ(classes.code, 3);
    EXPECT_THAT(classes.err, testing::AllOf(HasSubstr("Zeb Tilt"), HasSubstr("Zeb Tremolo")));
}

TEST_F(CatalogueCommandsTest, InstrumentsAreNotOffered)
{
    const RunResult one = Run({"info", EffectBundle("ZebTrio").string() + "#Zeb Tone"});
    EXPECT_EQ(one.code, 3);
    EXPECT_THAT(one.LastLine(), HasSubstr("instruments"));
    const RunResult only = Run({"info", FixtureBundle("InstrumentOnly").string()});
    EXPECT_EQ(only.code, 3);
    EXPECT_THAT(only.LastLine(), HasSubstr("instruments"));
}

TEST_F(CatalogueCommandsTest, ABundleThatCannotBeLoadedIsToldWhy)
{
    for (const char* name : {"NoFactory", "NullFactory", "NoClasses", "OtherArchitecture"})
    {
        const RunResult result = Run({"info", FixtureBundle(name).string()});
        EXPECT_EQ(result.code, 4) << name;
        EXPECT_THAT(result.LastLine(), HasSubstr(name));
    }
}

TEST_F(CatalogueCommandsTest, AFilterWhosePluginHasGoneIsNotLoaded)
{
    const std::filesystem::path copy = mFolder / "copies" / "ZebGain.vst3";
    std::filesystem::create_directories(copy.parent_path());
    std::filesystem::copy(EffectBundle("ZebGain"), copy, std::filesystem::copy_options::recursive);
    SearchIn(copy.parent_path());
    Succeed({"scan"});
    std::filesystem::remove_all(copy);
    const RunResult result = Run({"info", "Zeb Gain"});
    EXPECT_EQ(result.code, 4);
    EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr(copy.string()), HasSubstr("zebhost scan")));
}

TEST_F(CatalogueCommandsTest, InfoTellsBusesLatencyTailAndPresets)
{
    const nlohmann::json compressor = Succeed({"info", EffectBundle("ZebCompressor").string(), "--json"}).Json();
    const nlohmann::json& inputs = compressor.at("filter").at("inputs");
    ASSERT_EQ(inputs.size(), 2U);
    EXPECT_EQ(inputs.at(0).at("channels"), (std::vector<std::string>{"L", "R"}));
    EXPECT_EQ(inputs.at(1).at("type"), "side-chain");
    const nlohmann::json delay = Succeed({"info", EffectBundle("ZebDelay").string(), "--json"}).Json();
    EXPECT_EQ(delay.at("filter").at("latency"), 128);
    EXPECT_EQ(delay.at("filter").at("parameters"), 4);
    EXPECT_EQ(delay.at("filter").at("category"), "Delay");
    EXPECT_EQ(Succeed({"info", EffectBundle("ZebView").string(), "--json"}).Json().at("filter").at("editor"), true);
    EXPECT_THAT(Succeed({"info", EffectBundle("ZebDelay").string()}).out, HasSubstr("Latency:      128 frames"));
}

TEST_F(CatalogueCommandsTest, ParamsShowTheValuesAfterAChange)
{
    const std::string delay = EffectBundle("ZebDelay").string();
    const nlohmann::json before = Succeed({"params", delay, "--json"}).Json().at("parameters");
    EXPECT_EQ(before.at(0).at("name"), "Time");
    EXPECT_EQ(before.at(0).at("text"), "300.0");
    EXPECT_EQ(before.at(0).at("unit"), "ms");
    EXPECT_EQ(before.at(3).at("steps"), 4096);
    const nlohmann::json after =
        Succeed({"params", delay, "--set", "time=1 s", "--norm", "Mix=1", "--json"}).Json().at("parameters");
    EXPECT_EQ(after.at(0).at("text"), "1000.0");
    EXPECT_EQ(after.at(2).at("text"), "100.0");
    EXPECT_THAT(Succeed({"params", delay}).out, HasSubstr("300.0 ms"));
}

TEST_F(CatalogueCommandsTest, CountsThatLieDoNoHarm)
{
    for (const char* name : {"HugeCounts", "NegativeCounts", "HugeClassCount", "NegativeClassCount", "ManyParameters",
                             "ParameterInfoFails", "NoController", "SingleComponent"})
    {
        for (const char* command : {"info", "params"})
        {
            const RunResult result = Run({command, FixtureBundle(name).string(), "--json"});
            EXPECT_TRUE(result.code == 0 || result.code == 3 || result.code == 4) << name << result.err;
            EXPECT_EQ(result.Json().at("schema"), 1) << name;
        }
    }
}

TEST_F(CatalogueCommandsTest, ListSearchesInEveryColumn)
{
    Succeed({"scan", "--quiet"});
    for (const char* text : {"zeb gain", "TOOLS", "ZebGain.vst3", kGainID})
    {
        const nlohmann::json filters = Succeed({"list", text, "--json"}).Json().at("filters");
        ASSERT_EQ(filters.size(), 1U) << text;
        EXPECT_EQ(filters.at(0).at("id"), kGainID);
    }
    EXPECT_EQ(Run({"list", "nowhere"}).code, 3);
    EXPECT_EQ(Succeed({"list", "--names"}).out,
              "Zeb Balance\nZeb Compressor\nZeb Delay\nZeb Gain\nZeb Tilt\nZeb Tremolo\n");
}

TEST_F(CatalogueCommandsTest, AnEmptyCatalogueSaysWhatToDo)
{
    EXPECT_THAT(Succeed({"list"}).LastLine(), HasSubstr("zebhost scan"));
    EXPECT_THAT(Run({"info", "Gain"}).LastLine(), HasSubstr("zebhost scan"));
}

TEST_F(CatalogueCommandsTest, BlockedPluginsAreRefusedEverywhere)
{
    Succeed({"scan", "--quiet"});
    Succeed({"block", EffectBundle("ZebGain").string(), "--reason", "too loud"});
    for (const std::string& filter :
         {std::string("Zeb Gain"), std::string(kGainID), EffectBundle("ZebGain").string()})
    {
        const RunResult result = Run({"info", filter});
        EXPECT_EQ(result.code, 6) << filter;
        EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr("too loud"), HasSubstr("zebhost unblock")));
    }
    EXPECT_EQ(Succeed({"blocks", "--json"}).Json().at("blocked").at(0).at("reason"), "too loud");
    Succeed({"unblock", EffectBundle("ZebGain").string()});
    EXPECT_EQ(NameOf("Zeb Gain"), "Zeb Gain");
    EXPECT_EQ(Run({"unblock", EffectBundle("ZebGain").string()}).code, 3);
}

TEST_F(CatalogueCommandsTest, AFileNameMeansWhatTheCatalogueHasOfThatName)
{
    Succeed({"scan", "--quiet"});
    EXPECT_EQ(NameOf("ZebGain.vst3"), "Zeb Gain");
    EXPECT_EQ(Succeed({"block", "ZebGain.vst3", "--json"}).Json().at("path"), EffectBundle("ZebGain").string());
    EXPECT_EQ(Run({"info", "ZebGain.vst3"}).code, 6);
    const RunResult nothing = Succeed({"block", "Nowhere.vst3"});
    EXPECT_THAT(nothing.err, testing::ContainsRegex("there is nothing at .*/Nowhere.vst3"));
    EXPECT_THAT(Succeed({"unblock", "Nowhere.vst3"}).LastLine(), HasSubstr("nothing at its place"));
}

TEST_F(CatalogueCommandsTest, AReasonOfSeveralLinesStaysInOne)
{
    Succeed({"scan", "--quiet"});
    Succeed({"block", "Zeb Gain", "--reason", "too loud\nand shrill"});
    EXPECT_THAT(Succeed({"blocks"}).out, HasSubstr("too loud and shrill"));
    EXPECT_THAT(Run({"info", "Zeb Gain"}).LastLine(),
                testing::AllOf(testing::StartsWith("zebhost: "), HasSubstr("too loud and shrill")));
    EXPECT_EQ(Succeed({"blocks", "--json"}).Json().at("blocked").at(0).at("reason"), "too loud\nand shrill");
}

} // namespace

} // namespace zebtest
