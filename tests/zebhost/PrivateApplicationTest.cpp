// The example application that brings its own effects, as a user has it: built elsewhere, moved about, run.

#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;

const fs::path kBuilt = ZEB_PRIVATE_APPLICATION;

class PrivateApplicationTest : public ZebhostTest
{
protected:
    PrivateApplicationTest() { mVariables["XDG_CONFIG_HOME"] = Path("config"); }

    // Puts the application where somebody might want it.
    void InstallTo(const std::string& place)
    {
        mApplication = mFolder / place;
        fs::create_directories(mApplication.parent_path());
        fs::copy(kBuilt, mApplication, fs::copy_options::recursive);
    }

    void MoveTo(const std::string& place)
    {
        fs::create_directories((mFolder / place).parent_path());
        fs::rename(mApplication, mFolder / place);
        mApplication = mFolder / place;
    }

    RunResult RunApplication(const std::vector<std::string>& arguments = {}) const
    {
        std::vector<std::string> words = {(mApplication / "zeb_private").string()};
        words.insert(words.end(), arguments.begin(), arguments.end());
        return RunProgram(words, mVariables, mFolder);
    }

    std::string Line(const std::string& name, const std::string& place) const
    {
        return name + ": " + (mApplication / "Plug-Ins" / place).string() + "\n";
    }

    std::string Catalogue() const
    {
        return Line("ZebEcho2", "VST/ZebEcho2.vst") + Line("Zeb Gain", "VST3/ZebGain.vst3") +
               Line("Zeb Tremolo", "VST3/ZebTrio.vst3") + Line("Zeb Tilt", "VST3/ZebTrio.vst3") +
               Line("Zeb Tone", "VST3/ZebTrio.vst3");
    }

    // The plug-ins that a run opens, by the word of the system's loader.
    std::string Opened(const std::vector<std::string>& arguments)
    {
        mVariables["LD_DEBUG"] = "files";
        const std::string log = RunApplication(arguments).err;
        mVariables["LD_DEBUG"] = "";
        EXPECT_THAT(log, HasSubstr("libzebaudiofilterhost")) << "the loader tells nothing";
        std::string opened;
        for (const char* const name : {"ZebGain.so", "ZebTrio.so", "ZebEcho2.so"})
        {
            opened += log.find(name) != std::string::npos ? std::string(name) + " " : "";
        }
        return opened;
    }

    fs::path mApplication;
};

const char* const kPlaces[] = {"plain", "my vst3 & vst/Zeb",
                               "Zo\xc3\xab & S\xc3\xb6hne's <Apps>/\xe9\x9f\xb3 \"x\" &amp;", " blanks \\u0041 "};

TEST_F(PrivateApplicationTest, WhatIsShippedKnowsNoPlaceOfTheMachineThatBuiltIt)
{
    const std::string text = ReadText(kBuilt / "PrivatePluginConfig");
    EXPECT_THAT(text, HasSubstr("@VST3PRIVATEAPPLICATIONPLUGINPATH/ZebGain.@VST3PLUGINEXTENSION"));
    EXPECT_THAT(text, HasSubstr("@PRIVATEAPPLICATIONPLUGINPATH/ZebEcho2.@PLUGINEXTENSION"));
    EXPECT_THAT(text, Not(HasSubstr(kBuilt.parent_path().string())));
}

TEST_F(PrivateApplicationTest, HasItsEffectsWithoutAScanWhereverItIsMoved)
{
    InstallTo("first");
    for (const char* const place : kPlaces)
    {
        SCOPED_TRACE(place);
        MoveTo(place);
        const RunResult listed = RunApplication();
        EXPECT_EQ(listed.code, 0) << listed.err;
        EXPECT_EQ(listed.out, Catalogue());
        const RunResult played = RunApplication({"Zeb Gain"});
        EXPECT_EQ(played.out, "Zeb Gain: peak 0.5\n") << played.err;
        EXPECT_EQ(RunApplication({"ZebEcho2"}).code, 0);
    }
    EXPECT_FALSE(fs::exists(Path("config"))) << "nothing is kept on the machine";
    EXPECT_EQ(RunApplication({"Zeb Nothing"}).code, 1);
}

TEST_F(PrivateApplicationTest, OpensAPluginWhenItIsAskedForAndNoOther)
{
    InstallTo("Zeb");
    EXPECT_EQ(Opened({}), "");
    EXPECT_EQ(Opened({"Zeb Gain"}), "ZebGain.so ");
    EXPECT_EQ(Opened({"ZebEcho2"}), "ZebEcho2.so ");

    // Not even their presence is looked for.
    fs::remove_all(mApplication / "Plug-Ins");
    EXPECT_EQ(RunApplication().out, Catalogue());
    EXPECT_EQ(RunApplication({"Zeb Gain"}).code, 1);
}

TEST_F(PrivateApplicationTest, ItsEffectsStandAheadOfTheUsersOwn)
{
    const RunResult scanned = RunProgram(
        {ZEBHOST_PROGRAM, "scan", EffectBundle("ZebGain").string(), EffectBundle("ZebDelay").string(), "--quiet"},
        mVariables, mFolder);
    ASSERT_EQ(scanned.code, 0) << scanned.err;
    InstallTo("Zeb");
    EXPECT_EQ(RunApplication().out, Catalogue() + "Zeb Delay: " + EffectBundle("ZebDelay").string() + "\n");
}

} // namespace

} // namespace zebtest
