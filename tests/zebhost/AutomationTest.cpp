#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Sound.h"
#include "tests/zebhost/support/Zebhost.h"

namespace zebtest
{

namespace
{

using testing::HasSubstr;

constexpr std::size_t kFrames = 48000;

class AutomationTest : public ZebhostTest
{
protected:
    AutomationTest() { WriteSound(Path("in.wav"), mInput); }

    RunResult Render(const std::string& automation, const std::vector<std::string>& options = {}) const
    {
        WriteText(Path("moves.csv"), automation);
        std::vector<std::string> line = {"render",       EffectBundle("ZebGain").string(),
                                         Path("in.wav"), Path("out.wav"),
                                         "--automation", Path("moves.csv"),
                                         "--overwrite"};
        line.insert(line.end(), options.begin(), options.end());
        return Run(line);
    }

    Sound mInput = MakeNoise(1, kFrames);
};

TEST_F(AutomationTest, ChangesTakeEffectAtTheirSample)
{
    for (const char* block : {"512", "1000", "65536"})
    {
        const RunResult result = Render("time,parameter,value\n"
                                        "# silence from the first quarter to the half\n"
                                        "0.5, Gain, 0 dB\n"
                                        "0.25,Gain,-inf\n"
                                        "\n"
                                        "36001 frames,#1,norm:0\n",
                                        {"--block", block});
        ASSERT_EQ(result.code, 0) << result.err;
        const Sound output = ReadSound(Path("out.wav"));
        ASSERT_EQ(output.Frames(), kFrames);
        std::vector<int> wanted = mInput.channels[0];
        std::fill(wanted.begin() + 12000, wanted.begin() + 24000, 0);
        std::fill(wanted.begin() + 36001, wanted.end(), 0);
        EXPECT_TRUE(output.channels[0] == wanted) << block;
    }
}

TEST_F(AutomationTest, ManyChangesAtOneSampleAllCount)
{
    std::string lines;
    for (int number = 0; number < 200; ++number)
    {
        lines += "100 frames\tGain\t-20\n";
    }
    lines += "100 frames\tGain\t-inf\n";
    ASSERT_EQ(Render(lines).code, 0);
    const Sound output = ReadSound(Path("out.wav"));
    EXPECT_EQ(output.channels[0][99], mInput.channels[0][99]);
    EXPECT_EQ(output.channels[0][100], 0);
}

TEST_F(AutomationTest, AHeadingMayStandBehindAByteOrderMarkAndRemarks)
{
    for (const char* start : {"\xEF\xBB\xBF", "# made by hand\n\n", "\xEF\xBB\xBF# made by a program\r\n", ""})
    {
        const RunResult result = Render(std::string(start) + "time,parameter,value\r\n0,Gain,-inf\r\n");
        EXPECT_EQ(result.code, 0) << start << result.err;
        EXPECT_TRUE(ReadSound(Path("out.wav")).channels[0] == std::vector<int>(kFrames, 0)) << start;
        const RunResult twice = Render(std::string(start) + "time,parameter,value\ntime,parameter,value\n");
        EXPECT_EQ(twice.code, 2) << start;
    }
}

TEST_F(AutomationTest, AWrongLineIsNamed)
{
    for (const char* line :
         {"0.5,Gain", "soon,Gain,0", "-1,Gain,0", "0.5,Volume,0", "0.5,Gain,loud", "0.5,Gain,norm:2", "0.5,Gain,0,0"})
    {
        const RunResult result = Render(std::string("0,Gain,0\n") + line + "\n");
        EXPECT_EQ(result.code, 2) << line << result.err;
        EXPECT_THAT(result.LastLine(), HasSubstr("moves.csv, line 2: ")) << line;
    }
    EXPECT_THAT(Render("0,Gain,loud").LastLine(), HasSubstr("norm:0.5"));
}

} // namespace

} // namespace zebtest
