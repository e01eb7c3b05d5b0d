#include "foundation/zebcore/File.h"

#include "TempFolder.h"

#include "foundation/zebcore/CompareFileNames.h"
#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/IPlatformByteStream.h"
#include "foundation/zebcore/StringConversion.h"

#include <gtest/gtest.h>

#include <cerrno>

using namespace zebcore;
using namespace zebcore::filesupport;

TEST(File, NamesAndTitles)
{
    struct Sample
    {
        UTF16String mPath, mName, mTitle, mDir;
    };
    const Sample samples[] = {
        {u"/usr/lib/vst3/Hall.vst3", u"Hall.vst3", u"Hall", u"/usr/lib/vst3"},
        {u"/usr/lib/vst3/Hall.vst3/", u"Hall.vst3", u"Hall", u"/usr/lib/vst3"},
        {u"/a.b/Hall 2.1.vst3", u"Hall 2.1.vst3", u"Hall 2.1", u"/a.b"},
        {u"/a.b/Hall", u"Hall", u"Hall", u"/a.b"},
        {u"/a/.hidden", u".hidden", u".hidden", u"/a"},
        {u"/a/.hidden.txt", u".hidden.txt", u".hidden", u"/a"},
        {u"/a/dot.", u"dot.", u"dot", u"/a"},
        {u"/top", u"top", u"top", u"/"},
        {u"//top//", u"top", u"top", u"/"},
        {u"relative.so", u"relative.so", u"relative", u""},
        {u"/", u"/", u"/", u"/"},
        {u"", u"", u"", u""},
    };
    for (const auto& [path, name, title, dir] : samples)
    {
        const File file(path);
        EXPECT_TRUE(file.GetName() == name) << utility::NarrowFromUTF16(path);
        EXPECT_TRUE(file.GetTitle() == title) << utility::NarrowFromUTF16(path);
        EXPECT_TRUE(file.GetDir().FullPath() == dir) << utility::NarrowFromUTF16(path);
    }
    EXPECT_TRUE(File(Dir(u"/a/"), u"b.xml").FullPath() == u"/a/b.xml");
}

TEST(File, ExistsIsForFiles)
{
    const TempFolder folder;
    folder.Write("a", "x");
    std::filesystem::create_symlink("a", folder.Path("link"));
    std::filesystem::create_symlink("nowhere", folder.Path("dangling"));
    EXPECT_TRUE(folder.File("a").Exists());
    EXPECT_TRUE(folder.File("link").Exists());
    EXPECT_FALSE(folder.File("dangling").Exists());
    EXPECT_FALSE(folder.File("b").Exists());
    EXPECT_FALSE(File(folder.Dir().FullPath()).Exists());
    EXPECT_FALSE(File(folder.File("a").FullPath() + UTF16String(u"\0b", 2)).Exists()) << "not cut at the zero unit";
    EXPECT_FALSE(File(u"").Exists());
}

TEST(File, ComparisonIsExactAndThreeWay)
{
    EXPECT_EQ(CompareFileNames(u"/a/B.vst3", u"/a/B.vst3"), 0);
    EXPECT_LT(CompareFileNames(u"/a", u"/b"), 0);
    EXPECT_GT(CompareFileNames(u"/b", u"/a"), 0);
    EXPECT_LT(CompareFileNames(u"/a", u"/a/b"), 0);
#ifdef __linux__
    EXPECT_NE(CompareFileNames(u"/a/b.vst3", u"/a/B.vst3"), 0);
#endif
    EXPECT_GT(CompareFileNames(u"/\uFFFD", u"/\U0001F3B5"), 0) << "by code unit";
}

TEST(File, StreamReadsBlocks)
{
    const TempFolder folder;
    folder.Write("a", std::string("0123456789\0x", 12));
    IPlatformByteStream stream(folder.File("a"), utility::Flags<unsigned int>(1));
    EXPECT_EQ(stream.Length(), 12U);
    unsigned char block[8] = {};
    EXPECT_EQ(stream.ReadBlock(block, 8), 8U);
    EXPECT_EQ(block[7], '7');
    EXPECT_EQ(stream.ReadBlock(block, 0), 0U);
    EXPECT_EQ(stream.ReadBlock(block, 8), 4U);
    EXPECT_EQ(block[3], 'x');
    EXPECT_EQ(stream.ReadBlock(block, 8), 0U);
}

TEST(File, StreamOfWhatCannotBeReadThrows)
{
    const TempFolder folder;
    folder.Write("a", "x");
    const utility::Flags<unsigned int> read(IPlatformByteStream::kOpenForReading);
    EXPECT_THROW(IPlatformByteStream(folder.File("missing"), read), file_exception);
    EXPECT_THROW(IPlatformByteStream(File(folder.Dir().FullPath()), read), file_exception);
    EXPECT_THROW(IPlatformByteStream(folder.File("a"), utility::Flags<unsigned int>()), file_exception);
}

TEST(File, WholeFilesAreWrittenAndRead)
{
    const TempFolder folder;
    const UTF16String path = folder.File("a").FullPath();
    for (const std::size_t size : {std::size_t{0}, std::size_t{1}, std::size_t{65536}, std::size_t{300001}})
    {
        UTF8String text(size, u8'\0');
        for (std::size_t i = 0; i < size; ++i)
            text[i] = static_cast<char8_t>(i * 7);
        utility::FileUtils::SimpleWriteStringToFile(path, text);
        EXPECT_EQ(folder.Read("a").size(), size);
        EXPECT_TRUE(utility::FileUtils::SimpleReadStringFromFile(path) == text);
    }
    EXPECT_THROW(utility::FileUtils::SimpleWriteStringToFile(path + u"/b", u8"x"), file_exception);
}

#ifdef __linux__
TEST(File, ReadsFilesThatTellNoLength)
{
    EXPECT_FALSE(utility::FileUtils::SimpleReadStringFromFile(u"/proc/self/status").empty());
}
#endif
