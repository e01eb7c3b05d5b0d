// VST 2 plug-ins at the shell: they are found, told of, rendered, kept in presets and opened like all others.
#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

#include <cmath>
#include <set>

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::Contains;
using testing::HasSubstr;
using testing::Not;
using testing::UnorderedElementsAre;

constexpr std::size_t kFrames = 5000;

class VST2Test : public ZebhostTest
{
protected:
    VST2Test()
    {
        SearchIn(mFolder / "none");
        mVariables["VST_PATH"] = VST2EffectFolder().string();
        WriteSound(Path("in.wav"), mInput);
    }

    std::vector<std::string> Names() const
    {
        std::vector<std::string> names;
        const nlohmann::json document = Succeed({"list", "--json"}).Json();
        for (const nlohmann::json& filter : document.at("filters"))
        {
            EXPECT_EQ(filter.at("technology"), "VST 2");
            names.push_back(filter.at("name"));
        }
        return names;
    }

    Sound Rendered(const std::string& filter, std::vector<std::string> options = {}) const
    {
        options.insert(options.begin(), {"render", filter, Path("in.wav"), Path("out.wav"), "--overwrite"});
        Succeed(options);
        return ReadSound(Path("out.wav"));
    }

    // The texts of all parameters.
    static std::vector<std::string> Texts(const nlohmann::json& document)
    {
        std::vector<std::string> texts;
        for (const nlohmann::json& parameter : document.at("parameters"))
        {
            texts.push_back(parameter.at("name").get<std::string>() + "=" + parameter.at("text").get<std::string>());
        }
        return texts;
    }

    // The state and the reason of each plug-in of a scan's document, by file name.
    static std::map<std::string, std::pair<std::string, std::string>> States(const nlohmann::json& document)
    {
        std::map<std::string, std::pair<std::string, std::string>> states;
        for (const nlohmann::json& plugin : document.at("plugins"))
        {
            states[fs::path(plugin.at("path").get<std::string>()).filename().string()] = {plugin.at("state"),
                                                                                          plugin.value("reason", "")};
        }
        return states;
    }

    static std::vector<int> Inverted(std::vector<int> row)
    {
        for (int& sample : row)
        {
            sample = -sample;
        }
        return row;
    }

    Sound mInput = MakeNoise(2, kFrames);
    std::string mEcho = VST2Effect("ZebEcho2").string();
};

TEST_F(VST2Test, AScanFindsBothFormsAndTheMembersOfAShell)
{
    const RunResult result = Succeed({"scan"});
    EXPECT_THAT(result.LastLine(), HasSubstr("5 plug-ins scanned, 7 effects found"));
    EXPECT_THAT(Names(), UnorderedElementsAre("ZebGain2", "ZebGain2Plain", "ZebEcho2", "ZebPanel2", "Zeb Invert",
                                              "Zeb Swap", "Zeb Mono"));
    EXPECT_THAT(Succeed({"scan"}).LastLine(), HasSubstr("nothing to scan"));
}

TEST_F(VST2Test, BothKindsOfPluginsStandSideBySide)
{
    SearchIn(EffectFolder());
    Succeed({"scan", "--quiet"});
    const std::string names = Succeed({"list", "--names"}).out;
    EXPECT_THAT(names, testing::AllOf(HasSubstr("Zeb Gain\n"), HasSubstr("ZebGain2\n")));
    EXPECT_EQ(Succeed({"info", "Zeb Gain", "--json"}).Json().at("filter").at("technology"), "VST 3");
    EXPECT_EQ(Succeed({"info", "ZebGain2", "--json"}).Json().at("filter").at("technology"), "VST 2");
}

TEST_F(VST2Test, AFolderOfBadPluginsIsScannedToItsEndWithReasons)
{
    mVariables["VST_PATH"] = VST2FixtureFolder().string();
    const RunResult result = Run({"scan", "--json"});
    ASSERT_EQ(result.code, 0) << result.err;
    const auto states = States(result.Json());
    EXPECT_EQ(states.count("Helper.so"), 0U);
    for (const char* name : {"Normal.so", "Bundled.vst", "Flat.vst", "Suffixed.vst", "Nested.so", "Shell.so",
                             "ThrowsInDispatcher.so", "HugeCounts.so", "FullTexts.so"})
    {
        EXPECT_EQ(states.at(name).first, "scanned") << name;
    }
    for (const auto& [name, reason] : std::map<std::string, std::string>{{"Version2299.so", "older than VST 2.3"},
                                                                         {"NullEntry.so", "gives no plug-in"},
                                                                         {"WrongMagic.so", "not a VST 2 plug-in"},
                                                                         {"ThrowsInVersion.so", "exception"}})
    {
        EXPECT_EQ(states.at(name).first, "failed") << name;
        EXPECT_THAT(states.at(name).second, HasSubstr(reason)) << name;
    }
    EXPECT_EQ(Succeed({"blocks", "--json"}).Json().at("blocked").size(), 0U);
    EXPECT_THAT(Names(), Not(Contains("Synth")));
}

TEST_F(VST2Test, TellsWhyANamedFileIsNoPlugin)
{
    for (const auto& [name, reason] :
         std::map<std::string, std::string>{{"Helper", "entry point"}, {"Version2299", "older than VST 2.3"}})
    {
        const RunResult result = Run({"scan", VST2Fixture(name).string()});
        EXPECT_NE(result.code, 0) << name;
        EXPECT_THAT(result.LastLine(), HasSubstr(name + ".so")) << result.err;
        EXPECT_THAT(result.err, HasSubstr(reason)) << name;
    }
}

TEST_F(VST2Test, CrashesAndHangsAreNamedAndBlocked)
{
    for (const char* name : {"CrashOnLoad", "CrashInEntry", "CrashInOpen"})
    {
        const std::string path = VST2Hazard(name).string();
        const RunResult result = Run({"scan", path});
        EXPECT_EQ(result.code, 5) << name << result.err;
        EXPECT_THAT(result.err, HasSubstr(std::string(name) + ".so"));
        EXPECT_EQ(Run({"info", path}).code, 6) << name;
    }
    for (const char* name : {"HangInEntry", "HangInOpen", "EndlessShell"})
    {
        const RunResult result = Run({"scan", VST2Hazard(name).string(), "--timeout", "1"});
        EXPECT_EQ(result.code, 5) << name << result.err;
        EXPECT_THAT(result.err, HasSubstr("did not answer for 1 second")) << name;
    }
    const RunResult thrown = Run({"scan", VST2Hazard("ThrowInEntry").string()});
    EXPECT_EQ(thrown.code, 4) << thrown.err;
    EXPECT_THAT(thrown.err, HasSubstr("threw an exception"));
}

TEST_F(VST2Test, InfoAndParametersSayWhatThePluginSays)
{
    const nlohmann::json filter = Succeed({"info", mEcho, "--json"}).Json().at("filter");
    EXPECT_EQ(filter.at("name"), "ZebEcho2");
    EXPECT_EQ(filter.at("vendor"), "Zeb Audio");
    EXPECT_EQ(filter.at("id"), "2:1516389731 ZebEcho2");
    EXPECT_EQ(filter.at("editor"), false);
    EXPECT_THAT(Texts(Succeed({"params", mEcho, "--json"}).Json()),
                testing::ElementsAre("Time=90.0", "Feedbk=0.0", "Mix=30.0"));
    EXPECT_THAT(Succeed({"preset", "list", mEcho, "--json"}).Json().at("factory"),
                testing::IsSupersetOf({"Eighths", "Canyon", "Comb"}));
    EXPECT_THAT(Texts(Succeed({"params", mEcho, "--preset", "Canyon", "--json"}).Json()),
                testing::ElementsAre("Time=800.0", "Feedbk=60.0", "Mix=40.0"));
}

TEST_F(VST2Test, RendersToTheSample)
{
    for (const char* name : {"ZebGain2", "ZebGain2Plain"})
    {
        const std::string gain = VST2Effect(name).string();
        EXPECT_TRUE(Rendered(gain).channels == mInput.channels) << name;
        const Sound soft = Rendered(gain, {"--set", "Gain=-12"});
        const auto factor = static_cast<float>(std::pow(10.0F, -12.0F / 20.0F));
        for (std::size_t i = 0; i < kFrames; ++i)
        {
            const float expected = static_cast<float>(mInput.channels[1][i]) / 2147483648.0F * factor;
            ASSERT_NEAR(soft.channels[1][i] / 2147483648.0, static_cast<double>(expected), 2.0 / 8388608.0) << i;
        }
        EXPECT_TRUE(Rendered(gain, {"--set", "Gain=-inf"}).channels[0] == std::vector<int>(kFrames, 0)) << name;
    }
}

TEST_F(VST2Test, MembersOfAShellAreReachedByName)
{
    const std::string shell = VST2Effect("ZebShell2").string();
    const Sound inverted = Rendered(shell + "#Zeb Invert");
    EXPECT_TRUE(inverted.channels[0] == Inverted(mInput.channels[0]));
    Succeed({"scan", "--quiet"});
    // By the catalogue alone, in a process that has not scanned.
    EXPECT_EQ(Succeed({"info", "Zeb Swap", "--json"}).Json().at("filter").at("name"), "Zeb Swap");
    const Sound swapped = Rendered("Zeb Swap");
    EXPECT_TRUE(swapped.channels[0] == mInput.channels[1] && swapped.channels[1] == mInput.channels[0]);
}

TEST_F(VST2Test, MonoAndSurroundFilesFindTheirWay)
{
    for (const int channels : {1, 6})
    {
        const Sound input = MakeNoise(channels, kFrames);
        WriteSound(Path("in.wav"), input);
        EXPECT_TRUE(Rendered(VST2Effect("ZebGain2").string()).channels == input.channels) << channels;
    }
    const Sound mono = MakeNoise(1, kFrames);
    WriteSound(Path("in.wav"), mono);
    for (const char* fixture : {"CanMono", "Mono", "Normal"})
    {
        EXPECT_TRUE(Rendered(VST2Fixture(fixture).string()).channels == mono.channels) << fixture;
    }
}

TEST_F(VST2Test, OddPluginsRenderWithoutHarm)
{
    for (const char* fixture : {"AsksForTime", "CallsFromThread", "CallsInOpen", "FourOutputs", "NullArrangements",
                                "HugeArrangement", "OtherArrangement", "StubbornPins", "ThrowsInProcess"})
    {
        EXPECT_EQ(Run({"render", VST2Fixture(fixture).string(), Path("in.wav"), Path("out.wav"), "--overwrite"}).code,
                  0)
            << fixture;
    }
}

TEST_F(VST2Test, APluginThatThrowsIsNamedAndSoIsOneThatGivesNothing)
{
    const std::string thrower = VST2Fixture("ThrowsInParameters").string();
    const std::vector<std::vector<std::string>> lines = {
        {"params", thrower, "--norm", "#1=0.25"},
        {"render", thrower, Path("in.wav"), Path("out.wav"), "--norm", "#1=0.25"},
        {"render", thrower, Path("in.wav"), Path("out.wav"), "--set", "#1=0.25"}};
    for (const std::vector<std::string>& line : lines)
    {
        const RunResult result = Run(line);
        EXPECT_EQ(result.code, 1) << result.err;
        EXPECT_THAT(result.LastLine(),
                    testing::AllOf(HasSubstr(thrower + " threw an exception, \""), HasSubstr("zebhost block")));
        EXPECT_EQ(Files(), std::vector<std::string>{"in.wav"});
    }
    const RunResult silent =
        Succeed({"render", VST2Fixture("ThrowsInProcess").string(), Path("in.wav"), Path("out.wav"), "--json"});
    EXPECT_THAT(silent.err, HasSubstr("the whole output is silent"));
    EXPECT_EQ(silent.Json().at("files").at(0).at("silenced"), true);
}

TEST_F(VST2Test, ACrashInARenderLeavesNoFile)
{
    const RunResult result = Run({"render", VST2Hazard("CrashInProcess").string(), Path("in.wav"), Path("out.wav")});
    EXPECT_EQ(result.code, 5);
    EXPECT_EQ(Files(), std::vector<std::string>{"in.wav"});
}

TEST_F(VST2Test, ChunksComeBackFromStoreAndFile)
{
    for (const std::string& preset : {std::string("kept"), Path("kept.xml")})
    {
        Succeed({"preset", "save", mEcho, preset, "--preset", "Comb", "--set", "Mix=25"});
        EXPECT_THAT(Texts(Succeed({"preset", "load", mEcho, preset, "--json"}).Json()),
                    testing::ElementsAre("Time=10.0", "Feedbk=80.0", "Mix=25.0"));
        const Sound kept = Rendered(mEcho, {"--preset", preset});
        const Sound set = Rendered(mEcho, {"--norm", "Time=0.01", "--norm", "Feedbk=0.8", "--norm", "Mix=0.25"});
        EXPECT_TRUE(kept.channels == set.channels) << preset;
        EXPECT_FALSE(kept.channels == mInput.channels);
    }
}

class VST2EditTest : public VST2Test
{
protected:
    void SetUp() override
    {
        if (RunProgram({"xvfb-run", "--help"}, mVariables, mFolder).code != 0)
        {
            GTEST_SKIP() << "xvfb-run is not installed: no editor was opened";
        }
    }

    RunResult Edit(const fs::path& plugin, const std::vector<std::string>& options) const
    {
        std::vector<std::string> line = {"xvfb-run",
                                         "--auto-servernum",
                                         "--server-args=-screen 0 1024x768x24",
                                         ZEBHOST_PROGRAM,
                                         "--settings",
                                         Settings().string(),
                                         "edit",
                                         plugin.string(),
                                         "--seconds",
                                         "0.4"};
        line.insert(line.end(), options.begin(), options.end());
        return RunProgram(line, mVariables, mFolder);
    }

    // A number of a picture's header, such as its width at 16.
    static unsigned int NumberAt(const std::string& bytes, std::size_t at)
    {
        unsigned int value = 0;
        for (std::size_t index = at; index < at + 4 && index < bytes.size(); ++index)
        {
            value = value * 256 + static_cast<unsigned char>(bytes[index]);
        }
        return value;
    }
};

TEST_F(VST2EditTest, OpensTheEditorTakesItsPictureAndSavesWhatItHas)
{
    const RunResult result = Edit(VST2Effect("ZebPanel2"), {"--norm", "Width=0.25", "--screenshot", Path("panel.png"),
                                                            "--save", "kept", "--json"});
    ASSERT_EQ(result.code, 0) << result.err;
    const std::string png = ReadText(Path("panel.png"));
    ASSERT_EQ(png.substr(1, 3), "PNG");
    EXPECT_EQ(NumberAt(png, 16), 360U);
    EXPECT_EQ(NumberAt(png, 20), 140U);
    EXPECT_GT(std::set<char>(png.begin() + 60, png.end() - 20).size(), 3U) << "an empty window";
    EXPECT_THAT(Texts(Succeed({"preset", "load", VST2Effect("ZebPanel2").string(), "kept", "--json"}).Json()),
                testing::ElementsAre("Width=50"));
}

TEST_F(VST2EditTest, OddEditorsDoNotEndTheProcess)
{
    for (const char* name : {"NullRect", "OddRect", "SizesInOpen", "EditorRefuses", "ThrowsInDispatcher"})
    {
        const RunResult result = Edit(VST2Fixture(name), {});
        EXPECT_EQ(result.code, 0) << name << result.err;
    }
    EXPECT_EQ(Edit(VST2Fixture("NoEditor"), {}).code, 1);
}

} // namespace

} // namespace zebtest
