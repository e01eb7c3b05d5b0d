#include "audio/ChannelNames.h"
#include "audio/SampleFormat.h"
#include "audio/SoundFile.h"
#include "catalogue/FileNames.h"
#include "cli/Failure.h"
#include "filter/DenormalGuard.h"
#include "output/Numbers.h"
#include "output/PrintableText.h"
#include "output/TextTable.h"
#include "render/RenderOptions.h"
#include "render/SeparatedLine.h"

#include <gmock/gmock.h>

#include <filesystem>
#include <limits>

#include <unistd.h>

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

// sf_format_check says yes to some kinds of file that libsndfile then refuses.
TEST(SampleFormatTest, WhateverIsReadGoesIntoEveryKindOfFile)
{
    const std::vector<int> inputs = {
        SF_FORMAT_WAV | SF_FORMAT_PCM_U8,         SF_FORMAT_WAV | SF_FORMAT_ULAW,
        SF_FORMAT_WAV | SF_FORMAT_IMA_ADPCM,      SF_FORMAT_WAV | SF_FORMAT_DOUBLE,
        SF_FORMAT_AIFF | SF_FORMAT_DWVW_12,       SF_FORMAT_CAF | SF_FORMAT_ALAC_24,
        SF_FORMAT_FLAC | SF_FORMAT_PCM_S8,        SF_FORMAT_OGG | SF_FORMAT_VORBIS,
        SF_FORMAT_OGG | SF_FORMAT_OPUS,           SF_FORMAT_MPEG | SF_FORMAT_MPEG_LAYER_I,
        SF_FORMAT_MPEG | SF_FORMAT_MPEG_LAYER_II, SF_FORMAT_MPEG | SF_FORMAT_MPEG_LAYER_III};
    const std::string name = testing::TempDir() + "zebhost-format-" + std::to_string(getpid());
    for (const int input : inputs)
    {
        for (const char* kind :
             {".wav", ".w64", ".rf64", ".flac", ".aiff", ".au", ".caf", ".ogg", ".opus", ".mp3", ".raw", ".voc"})
        {
            SF_INFO info{};
            info.channels = 2;
            info.samplerate = 48000;
            info.format =
                ChooseFormat(SampleFormatOf(input), "in", name + kind, {}, info.channels, info.samplerate, 0).Code();
            const SoundFile file(sf_open(name.c_str(), SFM_WRITE, &info));
            const std::vector<float> sound(9600, 0.25F);
            EXPECT_EQ(sf_writef_float(file.get(), sound.data(), 4800), 4800) << std::hex << input << kind;
        }
    }
    std::filesystem::remove(name);
    EXPECT_THROW(ChooseFormat(SampleFormatOf(inputs.front()), "in", "out.opus", {}, 2, 44100, 0), Failure);
    EXPECT_THROW(ChooseFormat(SampleFormatOf(inputs.front()), "in", "out.mp3", {}, 2, 96000, 0), Failure);
    EXPECT_THROW(ChooseFormat({SF_FORMAT_SD2, SF_FORMAT_PCM_16}, "in.sd2", "out.sd2", {}, 2, 48000, 0), Failure);
}

TEST(SampleFormatTest, FilesOfFourGibibytesAreNotLeftToShortSizes)
{
    constexpr std::int64_t kSize = std::int64_t{1} << 32;
    for (const auto& [coding, bytes] : {std::pair(SF_FORMAT_PCM_16, 2), std::pair(SF_FORMAT_PCM_24, 3),
                                        std::pair(SF_FORMAT_FLOAT, 4), std::pair(SF_FORMAT_DOUBLE, 8)})
    {
        for (const int channels : {1, 2, 16})
        {
            const auto chosen = [&, code = coding](const char* output, std::int64_t frames)
            {
                return ChooseFormat({SF_FORMAT_WAV, code}, "in.x", output, {}, channels, 48000, frames).container;
            };
            const std::int64_t frames = kSize / bytes / channels;
            EXPECT_EQ(chosen("out.wav", frames), SF_FORMAT_RF64);
            EXPECT_NE(chosen("out.wav", frames - frames / 1000), SF_FORMAT_RF64);
            EXPECT_EQ(chosen("out.w64", frames), SF_FORMAT_W64);
            const SampleFormat aiff = {SF_FORMAT_AIFF, coding};
            EXPECT_LT(aiff.MostFrames(channels), frames);
            EXPECT_GT(aiff.MostFrames(channels), frames - frames / 1000);
        }
    }
    EXPECT_EQ(ParseTail("3600").LongestSeconds(), 3600);
    EXPECT_EQ(ParseTail("-90dB").LongestSeconds(), ParseTail("auto").LongestSeconds());
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
