#include "audio/ChannelNames.h"
#include "catalogue/FileNames.h"
#include "cli/Failure.h"
#include "filter/DenormalGuard.h"
#include "output/Numbers.h"
#include "output/PrintableText.h"
#include "output/TextTable.h"
#include "render/RenderOptions.h"
#include "render/SeparatedLine.h"

#include <gmock/gmock.h>

#include <limits>

namespace zebhost
{

namespace
{

using testing::ElementsAre;

TEST(FileNamesTest, AnyTextComesBackFromANameThatIsNoPath)
{
    for (const std::string text :
         {"plain", ".hidden", "..", "a/b", "100%", "%41", "tab\there", "3:0 1 2 3", "\xC3\xA4", " x"})
    {
        const std::string name = EncodeFileName(text);
        EXPECT_EQ(DecodeFileName(name), text);
        EXPECT_EQ(name.find('/'), std::string::npos);
        EXPECT_NE(name.front(), '.') << text;
    }
}

TEST(PrintableTextTest, PaddingControlCharactersAndLoneSurrogatesAreNotPrinted)
{
    EXPECT_EQ(Printable(std::u16string(u"Gain\0\0\0", 7)), "Gain");
    EXPECT_EQ(Printable(std::u16string(u"\0late", 5)), "");
    EXPECT_EQ(Printable(u"a\u001Bb"), "a\xEF\xBF\xBD"
                                      "b");
    EXPECT_EQ(Printable(std::u16string(1, static_cast<char16_t>(0xD800))), "\xEF\xBF\xBD");
    EXPECT_EQ(Printable(u"  \u00E4 "), "\xC3\xA4");
}

TEST(NumbersTest, NothingButAWholeNumberIsOne)
{
    EXPECT_EQ(ParseNumber(" +1.5 "), 1.5);
    EXPECT_EQ(ParseNumber("-2e3"), -2000);
    for (const char* text : {"", "1,5", "1.5x", "nan", "+-1", "0x10", "1 2"})
    {
        EXPECT_FALSE(ParseNumber(text)) << text;
    }
}

TEST(TextTableTest, ColumnsLineUpAlsoBehindLettersOfSeveralBytes)
{
    TextTable table({"A", "B"});
    table.AddRow({"\xC3\xA4\xC3\xA4", "1"});
    table.AddRow({"xyz", "2"});
    EXPECT_EQ(table.Text(false), "A    B\n\xC3\xA4\xC3\xA4   1\nxyz  2\n");
}

TEST(SeparatedLineTest, TabsWinOverCommasAndQuotesHoldBoth)
{
    EXPECT_THAT(SplitSeparatedLine("0.5, Gain , -6 dB"), ElementsAre("0.5", "Gain", "-6 dB"));
    EXPECT_THAT(SplitSeparatedLine("0.5\tGain, left\t1,5"), ElementsAre("0.5", "Gain, left", "1,5"));
    EXPECT_THAT(SplitSeparatedLine("1,\"Say \"\"hi\"\", you\",3"), ElementsAre("1", "Say \"hi\", you", "3"));
    EXPECT_THAT(SplitSeparatedLine("a,,\r"), ElementsAre("a", "", ""));
}

TEST(TailTest, IsAutoSecondsOrALevel)
{
    EXPECT_EQ(ParseTail("auto").kind, TailLength::Kind::Auto);
    EXPECT_EQ(ParseTail("2").seconds, 2);
    EXPECT_EQ(ParseTail("0.5s").seconds, 0.5);
    EXPECT_EQ(ParseTail("-90dB").decibels, -90);
    EXPECT_EQ(ParseTail("-60 DB").kind, TailLength::Kind::Level);
    for (const char* text : {"", "dB", "s", "-3", "3dB", "4000", "-201dB", "long"})
    {
        EXPECT_THROW(ParseTail(text), Failure) << text;
    }
}

TEST(ChannelNamesTest, EveryUsualLayoutHasNamesOfItsOwn)
{
    for (int channels = 1; channels <= 16; ++channels)
    {
        std::vector<std::string> names = ChannelNames(UsualLayout(channels));
        EXPECT_EQ(names.size(), static_cast<std::size_t>(channels));
        std::sort(names.begin(), names.end());
        EXPECT_EQ(std::adjacent_find(names.begin(), names.end()), names.end()) << channels;
    }
    EXPECT_THAT(ParseChannels("ls,R,3", UsualLayout(6)), ElementsAre(4, 1, 2));
}

TEST(DenormalGuardTest, DenormalsAreZeroWithinAndComeBackBehind)
{
    volatile float tiny = std::numeric_limits<float>::denorm_min();
    {
        const DenormalGuard guard;
        EXPECT_TRUE(tiny * 1.0F == 0.0F);
    }
    EXPECT_FALSE(tiny * 1.0F == 0.0F);
}

} // namespace

} // namespace zebhost
