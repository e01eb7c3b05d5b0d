#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

#include <array>
#include <cmath>
#include <limits>

namespace zebtest
{

namespace
{

namespace fs = std::filesystem;
using testing::HasSubstr;
using testing::Not;

constexpr std::size_t kFrames = 5000;
constexpr std::size_t kLatency = 128; // of the delay, as long as its look-ahead is not set

class RenderTest : public ZebhostTest
{
protected:
    RenderTest() { WriteSound(Path("in.wav"), mInput); }

    // A bundle's path, so that no test needs a scan.
    RunResult Render(const char* effect, std::vector<std::string> options,
                     const std::string& output = "out.wav") const
    {
        options.insert(options.begin(), {"render", EffectBundle(effect).string(), Path("in.wav"), Path(output)});
        return Run(options);
    }

    Sound Rendered(const char* effect, const std::vector<std::string>& options) const
    {
        const RunResult result = Render(effect, options);
        EXPECT_EQ(result.code, 0) << result.err;
        return ReadSound(Path("out.wav"));
    }

    // The row as the gain effect makes it at `decibels`.
    static std::vector<int> Amplified(const std::vector<int>& row, double decibels)
    {
        const auto gain = static_cast<float>(std::pow(10.0, decibels / 20));
        std::vector<int> result;
        for (const int sample : row)
        {
            const float value = static_cast<float>(sample) / 2147483648.0F * gain;
            result.push_back(static_cast<int>(std::nearbyint(static_cast<double>(value) * 8388608.0)) * 256);
        }
        return result;
    }

    Sound mInput = MakeNoise(2, kFrames);
};

TEST_F(RenderTest, GainAtZeroGivesBackEveryBit)
{
    const Sound output = Rendered("ZebGain", {});
    EXPECT_EQ(output.format, mInput.format);
    EXPECT_EQ(output.rate, mInput.rate);
    EXPECT_TRUE(output.channels == mInput.channels);
}

TEST_F(RenderTest, TextsBecomeTheValuesThatThePluginDisplays)
{
    for (const char* text : {"Gain=-6", "Gain=-6 dB", "gain=-6.0dB", "#1=-6"})
    {
        const Sound output = Rendered("ZebGain", {"--set", text, "--overwrite"});
        EXPECT_TRUE(output.channels[1] == Amplified(mInput.channels[1], -6.0)) << text;
    }
    const Sound silence = Rendered("ZebGain", {"--set", "Gain=-inf", "--overwrite"});
    EXPECT_TRUE(silence.channels[0] == std::vector<int>(kFrames, 0));
}

TEST_F(RenderTest, NormalisedValuesGoInAsTheyAre)
{
    const Sound output = Rendered("ZebGain", {"--norm", "Gain=0.625"});
    EXPECT_TRUE(output.channels[0] == Amplified(mInput.channels[0], -12.0));
    EXPECT_EQ(Render("ZebGain", {"--norm", "Gain=1.5", "--overwrite"}).code, 2);
}

TEST_F(RenderTest, LatencyIsCutOffTheFrontUnlessItIsToStay)
{
    const Sound trimmed = Rendered("ZebDelay", {"--set", "Mix=0", "--tail", "0"});
    EXPECT_TRUE(trimmed.channels == mInput.channels);

    const Sound kept = Rendered("ZebDelay", {"--set", "Mix=0", "--tail", "0", "--no-trim", "--overwrite"});
    ASSERT_EQ(kept.Frames(), kFrames + kLatency);
    const std::vector<int>& row = kept.channels[0];
    EXPECT_TRUE(std::all_of(row.begin(), row.begin() + kLatency, [](int sample) { return sample == 0; }));
    EXPECT_TRUE(std::equal(row.begin() + kLatency, row.end(), mInput.channels[0].begin(), mInput.channels[0].end()));
}

TEST_F(RenderTest, ALatencyThatASettingChangesIsCutOffAsItIsThen)
{
    for (const char* lookAhead : {"Look-ahead=0", "Look-ahead=1000", "Look-ahead=4096"})
    {
        const Sound output =
            Rendered("ZebDelay", {"--set", "Mix=0", "--set", lookAhead, "--tail", "0", "--overwrite"});
        EXPECT_TRUE(output.channels == mInput.channels) << lookAhead;
    }
}

TEST_F(RenderTest, BlocksOfAnySizeGiveTheSameSound)
{
    const Sound usual = Rendered("ZebDelay", {"--tail", "0.1"});
    for (const char* block : {"1", "37", "4096", "100000"})
    {
        const Sound other = Rendered("ZebDelay", {"--tail", "0.1", "--block", block, "--overwrite"});
        EXPECT_TRUE(other.channels == usual.channels) << block;
    }
}

TEST_F(RenderTest, TheTailIsAsLongAsItIsToldToBe)
{
    EXPECT_EQ(Rendered("ZebDelay", {"--tail", "0.5"}).Frames(), kFrames + 24000);
    EXPECT_EQ(Rendered("ZebDelay", {"--tail", "0", "--overwrite"}).Frames(), kFrames);
    // As the plug-in says: latency, and repeats of about 100 ms until they lie 60 dB below.
    const std::vector<std::string> quick = {"--set", "Time=100", "--set", "Feedback=50", "--overwrite"};
    EXPECT_NEAR(static_cast<double>(Rendered("ZebDelay", quick).Frames()), kFrames + kLatency + 11 * 4800, 11);
}

TEST_F(RenderTest, ATailByLevelEndsWhereItHasDiedAway)
{
    const Sound output =
        Rendered("ZebDelay", {"--set", "Time=100", "--set", "Feedback=10", "--tail", "-40dB", "--block", "64"});
    ASSERT_GT(output.Frames(), kFrames + 4800);
    ASSERT_LT(output.Frames(), kFrames + 4 * 4800);
    const std::vector<float>& row = output.floats[0];
    EXPECT_TRUE(std::any_of(row.end() - 64, row.end(), [](float sample) { return std::abs(sample) >= 0.01F; }));
}

TEST_F(RenderTest, AnEndlessTailComesToAnEnd)
{
    const RunResult result = Run({"render", FixtureBundle("TailInfinite").string(), Path("in.wav"), Path("out.wav")});
    EXPECT_EQ(result.code, 0) << result.err;
    EXPECT_EQ(ReadSound(Path("out.wav")).Frames(), kFrames);
}

TEST_F(RenderTest, LatenciesThatNobodyCanMeanAreNotCutOff)
{
    for (const char* name : {"LatencyNegative", "LatencyHuge"})
    {
        const RunResult result =
            Run({"render", FixtureBundle(name).string(), Path("in.wav"), Path("out.wav"), "--overwrite", "--json"});
        EXPECT_EQ(result.code, 0) << result.err;
        EXPECT_EQ(result.Json().at("files").at(0).at("latency"), 0) << name;
        EXPECT_EQ(ReadSound(Path("out.wav")).Frames(), kFrames) << name;
        const bool isTold = result.err.find("could not process every block") != std::string::npos;
        EXPECT_EQ(isTold, name == std::string("ProcessFails")) << name << result.err;
    }
}

TEST_F(RenderTest, SampleFormatsStayAsTheyWereWhereTheyCan)
{
    const std::array<std::pair<int, const char*>, 6> cases = {{{SF_FORMAT_WAV | SF_FORMAT_PCM_16, "x.wav"},
                                                               {SF_FORMAT_WAV | SF_FORMAT_FLOAT, "x.wav"},
                                                               {SF_FORMAT_WAV | SF_FORMAT_PCM_U8, "x.wav"},
                                                               {SF_FORMAT_AIFF | SF_FORMAT_PCM_24, "x.aiff"},
                                                               {SF_FORMAT_FLAC | SF_FORMAT_PCM_24, "x.flac"},
                                                               {SF_FORMAT_CAF | SF_FORMAT_PCM_16, "x.caf"}}};
    for (const auto& [format, name] : cases)
    {
        const std::string input = Path(std::string("in-") + name);
        WriteSound(input, MakeNoise(2, kFrames, format));
        const RunResult result = Run({"render", EffectBundle("ZebGain").string(), input, Path(name), "--overwrite"});
        EXPECT_EQ(result.code, 0) << result.err;
        const Sound output = ReadSound(Path(name));
        EXPECT_EQ(output.format, ReadSound(input).format) << name;
        EXPECT_TRUE(output.channels == ReadSound(input).channels) << name << format;
        fs::remove(input);
    }
}

TEST_F(RenderTest, TheOutputFormatCanBeChosen)
{
    EXPECT_EQ(Rendered("ZebGain", {"--format", "float"}).format, SF_FORMAT_WAV | SF_FORMAT_FLOAT);
    ASSERT_EQ(Render("ZebGain", {}, "out.flac").code, 0);
    EXPECT_EQ(ReadSound(Path("out.flac")).format, SF_FORMAT_FLAC | SF_FORMAT_PCM_24);
    EXPECT_TRUE(ReadSound(Path("out.flac")).channels == mInput.channels);
    EXPECT_EQ(Render("ZebGain", {"--format", "float"}, "float.flac").code, 2);
    EXPECT_EQ(Render("ZebGain", {}, "out.xyz").code, 2);
}

TEST_F(RenderTest, ClippingIsToldOf)
{
    const RunResult result = Render("ZebGain", {"--set", "Gain=24", "--json"});
    EXPECT_EQ(result.code, 0);
    EXPECT_THAT(result.err, HasSubstr("clipped"));
    EXPECT_GT(result.Json().at("files").at(0).at("clippedSamples"), 0);
    EXPECT_THAT(Render("ZebGain", {"--set", "Gain=24", "--format", "float", "--overwrite"}).err,
                Not(HasSubstr("clipped")));
    // What is advised has to be possible.
    EXPECT_THAT(result.err, HasSubstr("give --format float"));
    EXPECT_THAT(Render("ZebGain", {"--set", "Gain=24"}, "out.flac").err,
                HasSubstr("write a .wav with --format float"));
}

TEST_F(RenderTest, SamplesThatAreNoNumbersAreLaidToTheFileThatHasThem)
{
    const float nan = std::numeric_limits<float>::quiet_NaN();
    WriteFloats(Path("in.wav"), {nan, 0.5F, std::numeric_limits<float>::infinity(), 0.25F});
    const RunResult result = Render("ZebGain", {"--json"});
    EXPECT_EQ(result.code, 0);
    EXPECT_THAT(result.err, testing::AllOf(HasSubstr("in.wav has 2 samples that are no numbers"),
                                           Not(HasSubstr("Zeb Gain gave"))));
    EXPECT_EQ(result.Json().at("files").at(0).at("brokenSamplesIn"), 2);
    EXPECT_EQ(ReadSound(Path("out.wav")).floats[0], (std::vector<float>{0, 0.5F, 0, 0.25F}));
}

TEST_F(RenderTest, ADamagedInputIsNotTakenForAShortOne)
{
    const std::array<std::pair<const char*, int>, 2> kinds = {
        {{"cut.flac", SF_FORMAT_FLAC | SF_FORMAT_PCM_16}, {"cut.mp3", SF_FORMAT_MPEG | SF_FORMAT_MPEG_LAYER_III}}};
    const std::string compressor = EffectBundle("ZebCompressor").string();
    for (const auto& [name, format] : kinds)
    {
        WriteSound(Path(name), MakeNoise(2, 48000, format));
        fs::resize_file(Path(name), fs::file_size(Path(name)) * 6 / 10);
        WriteSound(Path("long.wav"), MakeNoise(2, 48000));
        for (const std::vector<std::string>& files :
             {std::vector<std::string>{Path(name), Path("out.wav")},
              std::vector<std::string>{Path("long.wav"), Path("out.wav"), "--side-chain", Path(name)}})
        {
            std::vector<std::string> line = {"render", compressor};
            line.insert(line.end(), files.begin(), files.end());
            const RunResult result = Run(line);
            EXPECT_EQ(result.code, 7) << result.err;
            EXPECT_THAT(result.LastLine(), HasSubstr(std::string(name) + " is damaged or cut off"));
            EXPECT_FALSE(fs::exists(Path("out.wav")));
        }
        fs::remove(Path(name));
    }
    for (const int format :
         {SF_FORMAT_WAV | SF_FORMAT_PCM_16, SF_FORMAT_AIFF | SF_FORMAT_PCM_24, SF_FORMAT_W64 | SF_FORMAT_FLOAT,
          SF_FORMAT_RF64 | SF_FORMAT_PCM_U8, SF_FORMAT_OGG | SF_FORMAT_OPUS})
    {
        WriteSound(Path("cut"), MakeNoise(2, 48000, format));
        const auto render = [this, &compressor]
        {
            return Run({"render", compressor, Path("cut"), Path("out.wav"), "--overwrite"});
        };
        EXPECT_THAT(render().err, Not(HasSubstr("cut off"))) << format;
        fs::resize_file(Path("cut"), fs::file_size(Path("cut")) / 2);
        const RunResult result = render();
        EXPECT_EQ(result.code, 0) << result.err;
        EXPECT_THAT(result.err, HasSubstr("cut seems to be cut off")) << format;
    }
}

TEST_F(RenderTest, NoFileIsReplacedUnlessItMayBe)
{
    WriteText(Path("out.wav"), "precious");
    const RunResult result = Render("ZebGain", {});
    EXPECT_EQ(result.code, 7);
    EXPECT_THAT(result.LastLine(), HasSubstr("--overwrite"));
    EXPECT_EQ(ReadText(Path("out.wav")), "precious");
    EXPECT_EQ(Render("ZebGain", {"--overwrite"}).code, 0);
    EXPECT_EQ(ReadSound(Path("out.wav")).Frames(), kFrames);
    EXPECT_EQ(Files(), (std::vector<std::string>{"in.wav", "out.wav"}));
}

TEST_F(RenderTest, AFileCanBeRenderedInPlace)
{
    ASSERT_EQ(Render("ZebGain", {"--norm", "Gain=0.625", "--overwrite"}, "in.wav").code, 0);
    EXPECT_TRUE(ReadSound(Path("in.wav")).channels[0] == Amplified(mInput.channels[0], -12.0));
}

TEST_F(RenderTest, FileTroubleNamesTheFileAndLeavesNothingBehind)
{
    WriteText(Path("text.wav"), "this is no sound");
    fs::create_directories(mFolder / "folder");
    const std::string gain = EffectBundle("ZebGain").string();
    const std::vector<std::pair<std::vector<std::string>, std::string>> cases = {
        {{"render", gain, Path("missing.wav"), Path("out.wav")}, "missing.wav"},
        {{"render", gain, Path("text.wav"), Path("out.wav")}, "text.wav"},
        {{"render", gain, Path("in.wav"), Path("folder")}, "folder"},
        {{"render", gain, Path("in.wav"), Path("no/such/folder/out.wav")}, "out.wav"},
        {{"render", gain, Path("in.wav"), Path("out.wav"), "--automation", Path("none.csv")}, "none.csv"},
        {{"render", gain, Path("in.wav"), Path("out.wav"), "--automation", Path("folder")}, "folder"},
        {{"render", gain, Path("folder"), Path("out.wav")}, "folder is a folder"},
    };
    for (const auto& [line, file] : cases)
    {
        const RunResult result = Run(line);
        EXPECT_EQ(result.code, 7) << result.err;
        EXPECT_THAT(result.LastLine(), HasSubstr(file));
        EXPECT_EQ(Files(), (std::vector<std::string>{"folder", "in.wav", "text.wav"}));
    }
}

TEST_F(RenderTest, WhatDoesNotFitOnTheDiskIsNoOutput)
{
    WriteSound(Path("in.wav"), MakeNoise(2, 48000));
    for (const char* name : {"out.wav", "out.flac", "out.ogg", "out.opus", "out.mp3", "out.caf"})
    {
        // 4 KiB, as the rest of a disk.
        const RunResult result =
            RunProgram({"sh", "-c", "ulimit -f 8; trap '' XFSZ; exec \"$@\"", "sh", ZEBHOST_PROGRAM, "--settings",
                        Settings().string(), "render", EffectBundle("ZebGain").string(), Path("in.wav"), Path(name)},
                       mVariables, mFolder);
        EXPECT_EQ(result.code, 7) << name << result.err;
        EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr(name), HasSubstr("make room on the disk")));
        EXPECT_EQ(Files(), std::vector<std::string>{"in.wav"});
    }
}

TEST_F(RenderTest, SeveralInputsGoIntoAFolderAndDoNotHearEachOther)
{
    WriteSound(Path("silence.wav"),
               [this]
               {
                   Sound silence = mInput;
                   silence.channels.assign(2, std::vector<int>(kFrames, 0));
                   return silence;
               }());
    const RunResult result = Run({"render", EffectBundle("ZebDelay").string(), Path("in.wav"), Path("silence.wav"),
                                  "--out-dir", Path("wet"), "--tail", "0", "--json"});
    ASSERT_EQ(result.code, 0) << result.err;
    EXPECT_EQ(result.Json().at("files").size(), 2U);
    EXPECT_EQ(ReadSound(Path("wet/in.wav")).Frames(), kFrames);
    EXPECT_TRUE(ReadSound(Path("wet/silence.wav")).channels[0] == std::vector<int>(kFrames, 0));
    fs::create_directories(mFolder / "more");
    fs::copy(Path("in.wav"), Path("more/in.wav"));
    EXPECT_EQ(Run({"render", EffectBundle("ZebDelay").string(), Path("in.wav"), Path("more/in.wav"), "--out-dir",
                   Path("twice")})
                  .code,
              2);
}

TEST_F(RenderTest, TheDocumentTellsWhatWasDone)
{
    const nlohmann::json document = Render("ZebDelay", {"--tail", "0.5", "--json"}).Json();
    EXPECT_EQ(document.at("filter").at("name"), "Zeb Delay");
    const nlohmann::json& file = document.at("files").at(0);
    EXPECT_EQ(file.at("framesIn"), kFrames);
    EXPECT_EQ(file.at("framesOut"), kFrames + 24000);
    EXPECT_EQ(file.at("latency"), kLatency);
    EXPECT_EQ(file.at("tailFrames"), 24000);
    EXPECT_EQ(file.at("sampleRate"), 48000);
    EXPECT_GT(file.at("speed"), 0);
}

TEST_F(RenderTest, AnEmptyFileStaysEmpty)
{
    WriteSound(Path("in.wav"), MakeNoise(2, 0));
    EXPECT_EQ(Rendered("ZebGain", {}).Frames(), 0U);
}

TEST_F(RenderTest, ParametersThatAreNotThereAreNamedWithThoseThatAre)
{
    const RunResult result = Render("ZebDelay", {"--set", "Volume=3"});
    EXPECT_EQ(result.code, 2);
    EXPECT_THAT(result.LastLine(), testing::AllOf(HasSubstr("Volume"), HasSubstr("Feedback")));
    EXPECT_THAT(Render("ZebDelay", {"--set", "Time=5000"}).LastLine(), HasSubstr("2000.0 ms"));
    EXPECT_EQ(Render("ZebDelay", {"--set", "Time"}).code, 2);
    EXPECT_EQ(Files(), std::vector<std::string>{"in.wav"});
}

TEST_F(RenderTest, APluginThatThrowsOrFailsInProcessDoesNotEndTheJob)
{
    for (const char* name : {"ProcessThrows", "ProcessFails", "EditsInProcess", "RestartInProcess", "EditsFromThread",
                             "RestartFromThread", "WritesParameters", "RunLoopUser"})
    {
        const RunResult result = Run(
            {"render", FixtureBundle(name).string(), Path("in.wav"), Path("out.wav"), "--overwrite", "--tail", "0"});
        EXPECT_EQ(result.code, 0) << name << result.err;
        EXPECT_EQ(ReadSound(Path("out.wav")).Frames(), kFrames) << name;
        const bool isTold = result.err.find("the whole output is silent") != std::string::npos;
        EXPECT_EQ(isTold, ReadSound(Path("out.wav")).channels[0] == std::vector<int>(kFrames, 0)) << name;
        EXPECT_TRUE(isTold || name != std::string("ProcessThrows"));
    }
}

} // namespace

} // namespace zebtest
