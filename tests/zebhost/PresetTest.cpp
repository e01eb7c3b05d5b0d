#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

using testing::HasSubstr;

class PresetTest : public ZebhostTest
{
protected:
    // The text of a parameter in a document.
    static std::string Text(const nlohmann::json& document, const std::string& name)
    {
        for (const nlohmann::json& parameter : document.at("parameters"))
        {
            if (parameter.at("name") == name)
            {
                return parameter.at("text");
            }
        }
        return "no such parameter";
    }

    std::string mDelay = EffectBundle("ZebDelay").string();
    std::string mGain = EffectBundle("ZebGain").string();
};

TEST_F(PresetTest, SettingsComeBackFromStoreAndFile)
{
    for (const std::string& preset :
         {std::string("Wide & far/../\xC3\xA4"), std::string("my preset"), Path("file.xml")})
    {
        const std::string name = preset == Path("file.xml") ? preset : preset.substr(preset.find_last_of('/') + 1);
        Succeed({"preset", "save", mDelay, name, "--set", "Time=125", "--set", "Mix=10"});
        const nlohmann::json document = Succeed({"preset", "load", mDelay, name, "--json"}).Json();
        EXPECT_EQ(Text(document, "Time"), "125.0") << name;
        EXPECT_EQ(Text(document, "Mix"), "10.0") << name;
        EXPECT_EQ(Text(document, "Feedback"), "30.0") << name;
    }
}

TEST_F(PresetTest, APresetGivesTheSameSoundAsTheSettingsItWasMadeFrom)
{
    WriteSound(Path("in.wav"), MakeNoise(2, 3000));
    Succeed({"preset", "save", mGain, "soft", "--set", "Gain=-7.5"});
    Succeed({"render", mGain, Path("in.wav"), Path("preset.wav"), "--preset", "soft"});
    Succeed({"render", mGain, Path("in.wav"), Path("set.wav"), "--set", "Gain=-7.5"});
    EXPECT_TRUE(ReadSound(Path("preset.wav")).channels == ReadSound(Path("set.wav")).channels);
    EXPECT_FALSE(ReadSound(Path("preset.wav")).channels == ReadSound(Path("in.wav")).channels);
}

TEST_F(PresetTest, ListsWhatIsStoredAndWhatThePluginBrings)
{
    const std::string tremolo = EffectBundle("ZebTrio").string() + "#Zeb Tremolo";
    Succeed({"preset", "save", tremolo, "mine", "--set", "Depth=77"});
    Succeed({"preset", "save", mGain, "soft"});
    EXPECT_EQ(Succeed({"preset", "list", "--json"}).Json().at("stored").size(), 2U);
    const nlohmann::json document = Succeed({"preset", "list", tremolo, "--json"}).Json();
    ASSERT_EQ(document.at("stored").size(), 1U);
    EXPECT_EQ(document.at("stored").at(0).at("name"), "mine");
    EXPECT_EQ(document.at("stored").at(0).at("filter"), "Zeb Tremolo");
    EXPECT_THAT(document.at("factory"), testing::Contains("Chopper"));
    const nlohmann::json chopper = Succeed({"params", tremolo, "--preset", "chopper", "--json"}).Json();
    EXPECT_EQ(Text(chopper, "Depth"), "100.0");
}

TEST_F(PresetTest, NoPresetIsReplacedUnlessItMayBe)
{
    Succeed({"preset", "save", mGain, "soft", "--set", "Gain=-3"});
    const RunResult refused = Run({"preset", "save", mGain, "soft", "--set", "Gain=-9"});
    EXPECT_EQ(refused.code, 7);
    EXPECT_THAT(refused.LastLine(), HasSubstr("--overwrite"));
    EXPECT_EQ(Text(Succeed({"preset", "load", mGain, "soft", "--json"}).Json(), "Gain"), "-3.0");
    Succeed({"preset", "save", mGain, "soft", "--set", "Gain=-9", "--overwrite"});
    EXPECT_EQ(Text(Succeed({"preset", "load", mGain, "soft", "--json"}).Json(), "Gain"), "-9.0");
}

TEST_F(PresetTest, WhatDoesNotFitIsRefused)
{
    EXPECT_EQ(Run({"preset", "load", mGain, "nothing"}).code, 3);
    Succeed({"preset", "save", mGain, Path("gain.xml")});
    const RunResult other = Run({"preset", "load", mDelay, Path("gain.xml")});
    EXPECT_EQ(other.code, 1);
    EXPECT_THAT(other.LastLine(), HasSubstr("Zeb Gain"));
    WriteText(Path("broken.xml"), ReadText(Path("gain.xml")).substr(0, 100));
    EXPECT_EQ(Run({"preset", "load", mGain, Path("broken.xml")}).code, 7);
}

TEST_F(PresetTest, StatesOfAnySizeComeBack)
{
    for (const char* name : {"StateEmpty", "StateFails", "StateLarge", "StateRefused"})
    {
        const std::string bundle = FixtureBundle(name).string();
        Succeed({"preset", "save", bundle, "kept"});
        const RunResult loaded = Run({"preset", "load", bundle, "kept"});
        EXPECT_TRUE(loaded.code == 0 || loaded.code == 1) << name << loaded.err;
    }
}

} // namespace

} // namespace zebtest
