// Audio Units at the shell: they are found, told of, rendered, kept in presets and shown like all others.
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

#include <cmath>
#include <set>

namespace zebtest
{

namespace
{

using testing::ElementsAre;
using testing::HasSubstr;
using testing::Not;

constexpr std::size_t kFrames = 5000;
constexpr const char* kGainID = "4:1635083896 2053595497 2053464696";

class AudioUnitTest : public ZebhostTest
{
protected:
    AudioUnitTest()
    {
        SearchIn(mFolder / "none");
        mVariables["VST_PATH"] = Path("none");
        mVariables["AUDIO_COMPONENT_PATH"] = ZEB_UNITS;
        WriteSound(Path("in.wav"), mInput);
        Succeed({"scan", "--quiet"});
    }

    Sound Rendered(const std::string& filter, std::vector<std::string> options = {}) const
    {
        options.insert(options.begin(), {"render", filter, Path("in.wav"), Path("out.wav"), "--overwrite"});
        Succeed(options);
        return ReadSound(Path("out.wav"));
    }

    static std::vector<std::string> Texts(const nlohmann::json& document)
    {
        std::vector<std::string> texts;
        for (const nlohmann::json& parameter : document.at("parameters"))
        {
            texts.push_back(parameter.at("name").get<std::string>() + "=" + parameter.at("text").get<std::string>());
        }
        return texts;
    }

    Sound mInput = MakeNoise(2, kFrames);
};

TEST_F(AudioUnitTest, AScanFindsEachUnitOnce)
{
    const RunResult again = Succeed({"scan", "--full"});
    EXPECT_THAT(again.LastLine(), HasSubstr("4 plug-ins scanned, 4 effects found"));
    EXPECT_THAT(again.out, HasSubstr("Zeb: Zeb Unit Mixer"));
    EXPECT_THAT(Succeed({"scan"}).LastLine(), HasSubstr("nothing to scan"));
    EXPECT_EQ(Succeed({"list", "--names"}).out, "Zeb Unit Delay\nZeb Unit Gain\nZeb Unit Mixer\nZeb Unit Tone\n");
    EXPECT_THAT(Succeed({"list", "--long"}).out, HasSubstr("Audio Unit"));
    const nlohmann::json list = Succeed({"list", "--json"}).Json();
    for (const nlohmann::json& filter : list.at("filters"))
    {
        EXPECT_EQ(filter.at("technology"), "Audio Unit");
        EXPECT_EQ(filter.at("vendor"), "Zeb");
    }
}

TEST_F(AudioUnitTest, AUnitThatIsGoneIsDropped)
{
    mVariables["AUDIO_COMPONENT_PATH"] = Path("none");
    const RunResult result = Run({"info", "Zeb Unit Gain"});
    EXPECT_EQ(result.code, 4);
    EXPECT_THAT(result.LastLine(), HasSubstr("is gone"));
    EXPECT_THAT(Succeed({"scan"}).LastLine(), HasSubstr("4 dropped"));
    EXPECT_EQ(Succeed({"list", "--names"}).out, "");
}

TEST_F(AudioUnitTest, BlocksTellOfUnitsByTheirNames)
{
    constexpr const char* kFullName = "Zeb: Zeb Unit Gain";
    for (const char* selector : {"Zeb Unit Gain", kGainID, kFullName})
    {
        EXPECT_EQ(Succeed({"info", selector, "--json"}).Json().at("filter").at("id"), kGainID) << selector;
        EXPECT_THAT(Succeed({"block", selector}).err, HasSubstr(std::string(kFullName) + " is blocked"));
        EXPECT_THAT(Succeed({"blocks"}).out, testing::AllOf(HasSubstr(kFullName), Not(HasSubstr("1635083896"))));
        const RunResult refused = Run({"info", kGainID});
        EXPECT_EQ(refused.code, 6);
        EXPECT_THAT(refused.LastLine(), testing::AllOf(HasSubstr(kFullName), HasSubstr(kGainID)));
        EXPECT_THAT(Succeed({"unblock", selector}).err, HasSubstr(kFullName));
    }
    Succeed({"block", kGainID});
    const nlohmann::json blocked = Succeed({"blocks", "--json"}).Json().at("blocked").at(0);
    EXPECT_EQ(blocked.at("place"), kFullName);
    EXPECT_EQ("4:" + blocked.at("path").get<std::string>(), kGainID);
    Succeed({"unblock", kFullName});
    EXPECT_EQ(Run({"unblock", kFullName}).code, 3);
}

// Its name has gone with it.
TEST_F(AudioUnitTest, ABlockedUnitThatIsGoneIsToldOfByItsCodes)
{
    Succeed({"block", kGainID});
    mVariables["AUDIO_COMPONENT_PATH"] = Path("none");
    EXPECT_THAT(Succeed({"blocks"}).out, HasSubstr("aufx zgai zebx"));
    EXPECT_THAT(Succeed({"unblock", "aufx zgai zebx"}).err, HasSubstr("aufx zgai zebx is not blocked any more"));
}

TEST_F(AudioUnitTest, AUnitThatFailsToRenderIsToldOf)
{
    mVariables["AUDIO_COMPONENT_PATH"] = ZEB_UNIT_FIXTURES;
    mVariables["ZEB_FIXTURE_RENDER_RESULT"] = "-10876";
    Succeed({"scan", "--quiet"});
    const RunResult result =
        Succeed({"render", "Recorder", Path("in.wav"), Path("out.wav"), "--overwrite", "--quiet", "--json"});
    EXPECT_THAT(result.err, testing::AllOf(HasSubstr("Recorder could not process every block"), HasSubstr("-10876")));
    EXPECT_EQ(result.Json().at("processFailed"), true);
    EXPECT_EQ(ReadSound(Path("out.wav")).channels[0], std::vector<int>(kFrames, 0));
    mVariables.erase("ZEB_FIXTURE_RENDER_RESULT");
    const RunResult works = Succeed({"render", "Recorder", Path("in.wav"), Path("out.wav"), "--overwrite", "--json"});
    EXPECT_EQ(works.Json().at("processFailed"), false);
    EXPECT_TRUE(ReadSound(Path("out.wav")).channels == mInput.channels);
}

TEST_F(AudioUnitTest, NameAndIDSelectTheSameUnit)
{
    for (const char* selector : {"Zeb Unit Gain", kGainID})
    {
        const nlohmann::json filter = Succeed({"info", selector, "--json"}).Json().at("filter");
        EXPECT_EQ(filter.at("id"), kGainID);
        EXPECT_EQ(filter.at("editor"), true);
        EXPECT_EQ(filter.at("factoryPresets"), nlohmann::json({"Unity", "Half"}));
        EXPECT_EQ(filter.at("outputs").at(0).at("channels"), nlohmann::json({"L", "R"}));
    }
    EXPECT_THAT(Succeed({"info", kGainID}).out, HasSubstr("Path:         Zeb: Zeb Unit Gain\n"));
    const nlohmann::json mixer = Succeed({"info", "Zeb Unit Mixer", "--json"}).Json().at("filter");
    EXPECT_EQ(mixer.at("inputs").at(0).at("name"), "Voice");
    EXPECT_EQ(mixer.at("inputs").at(1).at("name"), "Music");
}

TEST_F(AudioUnitTest, RendersToTheSample)
{
    EXPECT_TRUE(Rendered("Zeb Unit Gain").channels == mInput.channels);
    const Sound soft = Rendered(kGainID, {"--set", "Gain=-12"});
    const double factor = std::pow(10.0, -12.0 / 20.0);
    for (std::size_t frame = 0; frame < kFrames; ++frame)
    {
        ASSERT_NEAR(soft.channels[1][frame], mInput.channels[1][frame] * factor, 1024.0) << frame;
    }
    EXPECT_TRUE(Rendered("Zeb Unit Gain", {"--set", "Mute=1"}).channels[0] == std::vector<int>(kFrames, 0));
    const Sound half = Rendered("Zeb Unit Gain", {"--preset", "Half"});
    EXPECT_NEAR(half.channels[0][7], mInput.channels[0][7] / 2.0, 1024.0);
}

TEST_F(AudioUnitTest, TheLatencyIsTakenOut)
{
    EXPECT_EQ(Succeed({"info", "Zeb Unit Delay", "--json"}).Json().at("filter").at("latency"), 88);
    EXPECT_TRUE(Rendered("Zeb Unit Delay", {"--set", "Mix=0"}).channels == mInput.channels);
}

TEST_F(AudioUnitTest, MonoFilesAndGeneratorsFindTheirWay)
{
    const Sound mono = MakeNoise(1, kFrames);
    WriteSound(Path("in.wav"), mono);
    EXPECT_TRUE(Rendered("Zeb Unit Gain").channels == mono.channels);
    WriteSound(Path("in.wav"), mInput);
    const Sound tone = Rendered("Zeb Unit Tone", {"--set", "Frequency=1000"});
    ASSERT_EQ(tone.channels.size(), 2U);
    for (std::size_t frame = 0; frame < 480; ++frame)
    {
        const double expected = 0.25 * std::sin(2.0 * 3.14159265358979 * static_cast<double>(frame) / 48.0);
        ASSERT_NEAR(tone.channels[1][frame] / 2147483648.0, expected, 1e-4) << frame;
    }
}

TEST_F(AudioUnitTest, PresetsComeBackFromStoreAndFile)
{
    for (const std::string& preset : {std::string("kept"), Path("kept.xml")})
    {
        Succeed({"preset", "save", "Zeb Unit Delay", preset, "--set", "Time=0.01", "--set", "Mix=25"});
        EXPECT_THAT(Texts(Succeed({"preset", "load", "Zeb Unit Delay", preset, "--json"}).Json()),
                    ElementsAre("Time=0.01", "Mix=25", "Mode=0"));
        EXPECT_FALSE(Rendered("Zeb Unit Delay", {"--preset", preset}).channels == mInput.channels);
    }
}

// The bytes of a preset are a property list that the common tools read.
TEST_F(AudioUnitTest, OtherToolsReadThePreset)
{
    if (RunProgram({"plistutil", "--version"}, mVariables, mFolder).code != 0)
    {
        GTEST_SKIP() << "plistutil (libplist-utils) is not installed: no other tool has read a preset";
    }
    Succeed({"preset", "save", "Zeb Unit Delay", Path("kept.xml"), "--set", "Mix=25"});
    const std::string text = ReadText(Path("kept.xml"));
    const std::string key = "<utf8 key=\"ChunkData\">";
    const std::size_t begin = text.find(key) + key.size();
    WriteText(Path("chunk.txt"), text.substr(begin, text.find('<', begin) - begin));
    const RunResult list = RunProgram(
        {"sh", "-c",
         "base64 -d " + Path("chunk.txt") + " > " + Path("c.plist") + " && plistutil -i " + Path("c.plist")},
        mVariables, mFolder);
    ASSERT_EQ(list.code, 0) << list.err;
    for (const char* part : {"<key>manufacturer</key>", "<integer>2053399916</integer>", "<string>crossed</string>",
                             "<false/>", "AAEC/w==", "<real>25"})
    {
        EXPECT_THAT(list.out, HasSubstr(part));
    }
}

// Bundles that lie where nothing looks for them, and no catalogue.
class AudioUnitPathTest : public ZebhostTest
{
protected:
    AudioUnitPathTest()
    {
        SearchIn(mFolder / "none");
        mVariables["VST_PATH"] = Path("none");
        mVariables["AUDIO_COMPONENT_PATH"] = Path("none");
        WriteSound(Path("in.wav"), mInput);
        MakeBundle("One", {{"aufx", "zgai", "Zeb: Zeb Unit Gain"}});
        MakeBundle("Two", {{"aumu", "zins", "Zeb: Instrument"},
                           {"aufx", "zgaa", "Zeb: Wide Gain"},
                           {"aumf", "zgab", "Zeb: Narrow Gain"}});
    }

    struct Unit
    {
        const char* type;
        const char* subType;
        const char* name;
    };

    // The gain under these names.
    void MakeBundle(const std::string& name, const std::vector<Unit>& units) const
    {
        namespace fs = std::filesystem;
        const fs::path bundle = mFolder / "else" / (name + ".component");
        fs::create_directories(bundle.parent_path());
        fs::copy(fs::path(ZEB_UNITS) / "ZebUnitGain.component", bundle, fs::copy_options::recursive);
        for (const fs::directory_entry& entry : fs::directory_iterator(bundle / "Contents"))
        {
            if (entry.is_directory())
            {
                fs::rename(entry.path() / "ZebUnitGain.so", entry.path() / (name + ".so"));
            }
        }
        std::string list;
        for (const Unit& unit : units)
        {
            list += std::string("<dict><key>type</key><string>") + unit.type + "</string><key>subtype</key><string>" +
                    unit.subType + "</string><key>manufacturer</key><string>zebx</string><key>name</key><string>" +
                    unit.name + "</string><key>factoryFunction</key><string>ZebUnitGainFactory</string></dict>";
        }
        WriteText(bundle / "Contents/Info.plist",
                  "<?xml version=\"1.0\"?><plist version=\"1.0\"><dict><key>AudioComponents</key><array>" + list +
                      "</array></dict></plist>");
    }

    const std::string mOne = Path("else/One.component");
    const std::string mTwo = Path("else/Two.component");
    const Sound mInput = MakeNoise(2, kFrames);
};

TEST_F(AudioUnitPathTest, ABundleWithOneUnitMeansThatUnit)
{
    EXPECT_EQ(Succeed({"info", mOne, "--json"}).Json().at("filter").at("id"), kGainID);
    EXPECT_THAT(Succeed({"params", mOne}).out, HasSubstr("Gain"));
    Succeed({"render", mOne, Path("in.wav"), Path("out.wav")});
    EXPECT_TRUE(ReadSound(Path("out.wav")).channels == mInput.channels);
    Succeed({"preset", "save", mOne, Path("kept.xml"), "--set", "Gain=-6"});
    Succeed({"preset", "load", mOne + "/", Path("kept.xml")});
    EXPECT_EQ(Succeed({"list", "--names"}).out, "") << "it was looked at, and not kept";
}

TEST_F(AudioUnitPathTest, ABundleWithSeveralUnitsWantsAName)
{
    const RunResult several = Run({"info", mTwo});
    EXPECT_EQ(several.code, 3);
    EXPECT_THAT(several.err,
                testing::AllOf(HasSubstr("Wide Gain"), HasSubstr("Narrow Gain"), Not(HasSubstr("Instrument"))));
    EXPECT_THAT(several.LastLine(), HasSubstr(mTwo + "#NAME"));
    EXPECT_EQ(Succeed({"info", mTwo + "#narrow", "--json"}).Json().at("filter").at("name"), "Narrow Gain");
}

TEST_F(AudioUnitPathTest, ScansAndBlocksAllUnitsOfABundle)
{
    EXPECT_THAT(Succeed({"scan", mTwo}).LastLine(), HasSubstr("2 plug-ins scanned, 2 effects found"));
    EXPECT_EQ(Succeed({"list", "--names"}).out, "Narrow Gain\nWide Gain\n");
    EXPECT_THAT(Succeed({"scan", Path("else")}).LastLine(), HasSubstr("3 plug-ins scanned, 3 effects found"));

    EXPECT_EQ(Succeed({"block", mTwo, "--json"}).Json().at("plugins").size(), 2U);
    for (const std::string command : {"info", "scan"})
    {
        EXPECT_EQ(Run({command, mTwo}).code, 6) << command;
    }
    EXPECT_EQ(Run({"block", mTwo + "#Wide Gain"}).code, 3) << "as with all bundles";
    Succeed({"unblock", "Wide Gain"});
    EXPECT_EQ(Succeed({"info", mTwo, "--json"}).Json().at("filter").at("name"), "Wide Gain");
    EXPECT_THAT(Succeed({"unblock", mTwo}).err,
                HasSubstr("Narrow Gain is not blocked any more; 'zebhost scan " + mTwo + "' tries it"));
    EXPECT_EQ(Run({"unblock", mTwo}).code, 3);
}

TEST_F(AudioUnitPathTest, SaysWhyABundleGivesNothing)
{
    MakeBundle("Instrument", {{"aumu", "zins", "Zeb: Instrument"}});
    MakeBundle("Damaged", {});
    WriteText(Path("else/Damaged.component/Contents/Info.plist"), "bplist00");
    for (const char* command : {"info", "scan", "block"})
    {
        for (const char* name : {"else/Instrument.component", "else/Damaged.component"})
        {
            const RunResult result = Run({command, Path(name)});
            EXPECT_EQ(result.code, 3) << command << name;
            EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr(name), HasSubstr("Info.plist"))) << command;
        }
    }
    EXPECT_THAT(Run({"info", Path("else/None.component")}).LastLine(), HasSubstr("there is nothing at this path"));
}

class AudioUnitEditTest : public AudioUnitTest
{
protected:
    void SetUp() override
    {
        if (RunProgram({"xvfb-run", "--help"}, mVariables, mFolder).code != 0)
        {
            GTEST_SKIP() << "xvfb-run is not installed: no editor was opened";
        }
    }
};

TEST_F(AudioUnitEditTest, ShowsEveryUnitAndSavesWhatItHas)
{
    for (const char* unit : {"Zeb Unit Delay", "Zeb Unit Gain", "Zeb Unit Mixer", "Zeb Unit Tone"})
    {
        const RunResult result =
            RunProgram({"xvfb-run", "--auto-servernum", "--server-args=-screen 0 1024x768x24", ZEBHOST_PROGRAM,
                        "--settings", Settings().string(), "edit", unit, "--seconds", "0.4", "--norm", "#1=0.25",
                        "--screenshot", Path("view.png"), "--overwrite", "--save", "kept", "--json"},
                       mVariables, mFolder);
        ASSERT_EQ(result.code, 0) << unit << result.err;
        const std::string png = ReadText(Path("view.png"));
        ASSERT_EQ(png.substr(1, 3), "PNG") << unit;
        EXPECT_GT(std::set<char>(png.begin() + 60, png.end() - 20).size(), 50U) << "an empty window: " << unit;
        const nlohmann::json loaded = Succeed({"preset", "load", unit, "kept", "--json"}).Json();
        EXPECT_NEAR(loaded.at("parameters").at(0).at("value").get<double>(), 0.25, 1e-5) << unit;
    }
}

} // namespace

} // namespace zebtest
