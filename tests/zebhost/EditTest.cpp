#include "tests/plugins/FixturePaths.h"
#include "tests/zebhost/support/Zebhost.h"

#include <set>

namespace zebtest
{

namespace
{

using testing::HasSubstr;

// Its windows are opened on a virtual screen.
class EditTest : public ZebhostTest
{
protected:
    bool HasScreen() const { return RunProgram({"xvfb-run", "--help"}, mVariables, mFolder).code == 0; }

    RunResult Edit(const std::filesystem::path& bundle, const std::vector<std::string>& options) const
    {
        std::vector<std::string> line = {"xvfb-run",
                                         "--auto-servernum",
                                         "--server-args=-screen 0 1024x768x24",
                                         ZEBHOST_PROGRAM,
                                         "--settings",
                                         Settings().string(),
                                         "edit",
                                         bundle.string(),
                                         "--seconds",
                                         "0.4"};
        line.insert(line.end(), options.begin(), options.end());
        return RunProgram(line, mVariables, mFolder);
    }

    static unsigned int BigEndian(const std::string& bytes, std::size_t at)
    {
        unsigned int value = 0;
        for (std::size_t index = at; index < at + 4; ++index)
        {
            value = value * 256 + static_cast<unsigned char>(bytes[index]);
        }
        return value;
    }
};

TEST_F(EditTest, WithoutAScreenOrAnEditorThereIsNothingToShow)
{
    mVariables["DISPLAY"] = "";
    const RunResult noScreen = Run({"edit", EffectBundle("ZebView").string()});
    EXPECT_EQ(noScreen.code, 1);
    EXPECT_THAT(noScreen.LastLine(), HasSubstr("DISPLAY"));
    const RunResult noEditor = Run({"edit", EffectBundle("ZebGain").string()});
    EXPECT_EQ(noEditor.code, 1);
    EXPECT_THAT(noEditor.LastLine(), HasSubstr("no editor"));
}

TEST_F(EditTest, OpensTheEditorAndTakesItsPicture)
{
    if (!HasScreen())
    {
        GTEST_SKIP() << "xvfb-run is not installed: no editor was opened";
    }
    const RunResult result = Edit(EffectBundle("ZebView"), {"--screenshot", Path("view.png")});
    ASSERT_EQ(result.code, 0) << result.err;
    const std::string png = ReadText(Path("view.png"));
    ASSERT_EQ(png.substr(1, 3), "PNG");
    EXPECT_EQ(BigEndian(png, 16), 320U);
    EXPECT_EQ(BigEndian(png, 20), 120U);
    const std::set<char> bytes(png.begin() + 60, png.end() - 20);
    EXPECT_GT(bytes.size(), 3U) << "an empty window";
    EXPECT_EQ(Edit(EffectBundle("ZebView"), {"--screenshot", Path("view.png")}).code, 7);
}

TEST_F(EditTest, SavesWhatThePluginHasAtTheEnd)
{
    if (!HasScreen())
    {
        GTEST_SKIP() << "xvfb-run is not installed: no editor was opened";
    }
    const RunResult result = Edit(EffectBundle("ZebView"), {"--norm", "Balance=0.25", "--save", "kept", "--json"});
    ASSERT_EQ(result.code, 0) << result.err;
    const nlohmann::json parameters =
        Succeed({"preset", "load", EffectBundle("ZebView").string(), "kept", "--json"}).Json().at("parameters");
    EXPECT_EQ(parameters.at(0).at("value"), 0.25);
}

TEST_F(EditTest, OddEditorsDoNotEndTheProcess)
{
    if (!HasScreen())
    {
        GTEST_SKIP() << "xvfb-run is not installed: no editor was opened";
    }
    for (const char* name : {"ResizesInAttached", "AttachFails", "RunLoopUser", "RunLoopQuitter"})
    {
        EXPECT_EQ(Edit(FixtureBundle(name), {}).code, 0) << name;
    }
    EXPECT_EQ(Edit(FixtureBundle("ViewUnsupported"), {}).code, 1);
    EXPECT_EQ(Edit(FixtureBundle("NoView"), {}).code, 1);
}

TEST_F(EditTest, OddVST2EditorsGetAWindowOfTheSizeTheyMean)
{
    if (!HasScreen())
    {
        GTEST_SKIP() << "xvfb-run is not installed: no editor was opened";
    }
    struct Case
    {
        const char* name;
        unsigned int width;
        unsigned int height;
        const char* remark;
    };
    for (const Case& each :
         {Case{"Normal", 400, 300, ""}, Case{"NullRect", 480, 320, ""}, Case{"SizesInOpen", 640, 320, ""},
          Case{"ThrowsInDispatcher", 480, 320, "threw an exception while its editor was open"}})
    {
        const RunResult result = Edit(VST2Fixture(each.name), {"--screenshot", Path("odd.png"), "--overwrite"});
        EXPECT_EQ(result.code, 0) << each.name;
        EXPECT_THAT(result.err, HasSubstr(each.remark)) << each.name;
        const std::string png = ReadText(Path("odd.png"));
        EXPECT_EQ(BigEndian(png, 16), each.width) << each.name;
        EXPECT_EQ(BigEndian(png, 20), each.height) << each.name;
    }
    EXPECT_EQ(Edit(VST2Fixture("NoEditor"), {}).code, 1);
}

} // namespace

} // namespace zebtest
