#include "TempFolder.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/PropListUtils.h"
#include "foundation/zebcore/StringConversion.h"
#include "foundation/zebcore/internal/FileSystemCalls.h"
#include "tests/persistence/SaveFaults.h"

#include <gtest/gtest.h>

#include <sys/stat.h>

#include <cerrno>
#include <system_error>

using namespace zebcore;
using proplist::PropList;
using namespace proplist::utils;

namespace
{

class PropListFile : public testing::Test
{
protected:
    void TearDown() override { filesupport::Dir::SetPrefDir(filesupport::Dir()); }

    static PropList OneEntry(const UTF8String& key, int value)
    {
        PropList list;
        list.SetValue(key, value);
        return list;
    }

    static int ValueOf(const PropList& list, const UTF8String& key)
    {
        int value = -1;
        list.GetValue(key, value);
        return value;
    }

    // Written in many blocks.
    static PropList LongList()
    {
        PropList list;
        PropList* innermost = &list;
        for (int section = 0; section < 5; ++section)
        {
            innermost = &innermost->GetOrCreateSubList(u8"below");
            for (int entry = 0; entry < 1000; ++entry)
                innermost->SetValue(utility::UTF8FromNarrow("key" + std::to_string(entry)), entry);
        }
        list.SetValue(u8"chunk", UTF8String(300000, u8'c'));
        list.SetValue(u8"last", 1);
        return list;
    }

    const TempFolder mFolder;
};

} // namespace

TEST_F(PropListFile, FileHoldsWhatWritePropListGives)
{
    filesupport::File file = mFolder.File("settings.xml");
    for (const PropList& list : {LongList(), PropList(), OneEntry(u8"a", 1)})
    {
        SavePropList(file, list);
        UTF8String text;
        WritePropList(text, list);
        EXPECT_TRUE(mFolder.Read("settings.xml") == utility::NarrowFromUTF8(text));
    }
    PropList read = OneEntry(u8"stale", 1);
    EXPECT_TRUE(LoadPropList(file.FullPath(), read, false));
    EXPECT_EQ(ValueOf(read, u8"a"), 1);
    EXPECT_EQ(ValueOf(read, u8"stale"), -1);
}

TEST_F(PropListFile, MissingAndUnreadableFilesThrow)
{
    PropList list = OneEntry(u8"kept", 1);
    const std::pair<filesupport::File, int> samples[] = {
        {mFolder.File("missing.xml"), ENOENT},
        {filesupport::File(mFolder.Dir().FullPath()), EISDIR},
        {filesupport::File(u""), ENOENT},
        {filesupport::File(UTF16String(u"/etc/passwd\0.xml", 16)), EINVAL},
        {filesupport::File(u"/proc/self/mem"), EIO}, // opens, and fails at the first byte
    };
    for (const auto& [file, error] : samples)
        try
        {
            LoadPropList(file.FullPath(), list, false);
            FAIL() << error;
        }
        catch (const filesupport::file_exception& failure)
        {
            EXPECT_EQ(failure.Error(), error);
            EXPECT_TRUE(failure.Path() == file.FullPath());
            const std::string sentence = failure.what();
            EXPECT_NE(sentence.find(utility::NarrowFromUTF16(file.FullPath()).c_str()), std::string::npos)
                << sentence;
            EXPECT_TRUE(sentence.ends_with(std::generic_category().message(error))) << sentence;
        }
    EXPECT_EQ(ValueOf(list, u8"kept"), 1);
}

TEST_F(PropListFile, MalformedFileReadsAsEmpty)
{
    mFolder.Write("settings.xml", "<proplist format='1'><int key='a'>1</int>");
    PropList list = OneEntry(u8"stale", 1);
    EXPECT_FALSE(LoadPropList(mFolder.File("settings.xml").FullPath(), list, false));
    EXPECT_TRUE(list.IsEmpty());
}

// Wherever a block ends: within a character, an entity, an escape, a name.
TEST_F(PropListFile, FileOfManyBlocksReadsAsItsText)
{
    constexpr std::size_t kBlock = 1U << 16U;
    for (std::size_t shift = 0; shift < 40; ++shift)
    {
        PropList list;
        list.SetValue(u8"first", UTF16String(kBlock - 100 - shift, u'a'));
        list.SetValue(u8"second", UTF16String(u"\u00e9&\u0001\U0001f600\u20ac<end"));
        list.SetValue(u8"third", UTF8String(3 * kBlock, u8'b'));
        UTF8String text;
        WritePropList(text, list);
        mFolder.Write("settings.xml", utility::NarrowFromUTF8(text));
        PropList read;
        ASSERT_TRUE(LoadPropList(mFolder.File("settings.xml").FullPath(), read, false));
        UTF8String again;
        WritePropList(again, read);
        ASSERT_TRUE(again == text) << shift;
    }
}

TEST_F(PropListFile, TagsLongerThanABlockAreRead)
{
    const std::string key(300000, 'k');
    mFolder.Write("settings.xml", "<proplist format='1'><!--" + key + "--><int key='" + key + "'>1</int></proplist>");
    PropList list;
    EXPECT_TRUE(LoadPropList(mFolder.File("settings.xml").FullPath(), list, false));
    EXPECT_EQ(ValueOf(list, UTF8String(key.begin(), key.end())), 1);
}

TEST_F(PropListFile, FaultInALaterBlockLeavesNothing)
{
    const std::string lines(200000, '\n');
    mFolder.Write("settings.xml", "<proplist format='1'><int key='a'>1</int>" + lines + "</wrong>");
    PropList list = OneEntry(u8"stale", 1);
    EXPECT_FALSE(LoadPropList(mFolder.File("settings.xml").FullPath(), list, false));
    EXPECT_TRUE(list.IsEmpty());
}

TEST_F(PropListFile, WrapperIsFilledThroughItsAccessors)
{
    class Wrapper final : public PropList
    {
    public:
        using PropList::SetValue;
        void SetValue(const UTF8String& key, const int& value) override { PropList::SetValue(key, value + 100); }
    };
    Wrapper list;
    list.SetValue(u8"stale", 1);
    mFolder.Write("settings.xml", "<proplist format='1'><int key='a'>1</int></proplist>");
    EXPECT_TRUE(LoadPropList(mFolder.File("settings.xml").FullPath(), list, false));
    EXPECT_EQ(ValueOf(list, u8"a"), 101);
    EXPECT_EQ(ValueOf(list, u8"stale"), -1);
}

TEST_F(PropListFile, MergingAddsToWhatIsThere)
{
    mFolder.Write("add.xml", "<proplist format='1'><int key='a'>2</int>"
                             "<list key='l'><int key='y'>4</int></list></proplist>");
    PropList list = OneEntry(u8"a", 1);
    list.SetValue(u8"b", 5);
    list.GetOrCreateSubList(u8"l").SetValue(u8"x", 3);
    EXPECT_TRUE(LoadPropList(mFolder.File("add.xml").FullPath(), list, true));
    EXPECT_EQ(ValueOf(list, u8"a"), 2);
    EXPECT_EQ(ValueOf(list, u8"b"), 5);
    EXPECT_EQ(ValueOf(*list.GetSubList(u8"l"), u8"x"), 3);
    EXPECT_EQ(ValueOf(*list.GetSubList(u8"l"), u8"y"), 4);
    mFolder.Write("bad.xml", "<proplist format='1'><int key='a'>9</int>");
    EXPECT_FALSE(LoadPropList(mFolder.File("bad.xml").FullPath(), list, true));
    EXPECT_EQ(ValueOf(list, u8"a"), 2);
}

TEST_F(PropListFile, PreferenceFolderIsMadeWhenFirstSaved)
{
    const filesupport::Dir preferences(mFolder.Dir(), u"config/zeb");
    filesupport::Dir::SetPrefDir(preferences);
    EXPECT_TRUE(filesupport::Dir::PrefDir().FullPath() == preferences.FullPath());
    EXPECT_FALSE(preferences.Exists());
    filesupport::File file(filesupport::Dir::PrefDir(), u"settings.xml");
    SavePropList(file, OneEntry(u8"a", 1));
    EXPECT_TRUE(file.Exists());
    struct stat status = {};
    ASSERT_EQ(stat(mFolder.Path("config/zeb").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 0777U, 0700U);
    filesupport::File below(filesupport::Dir::PrefDir(), u"presets/Hall.xml");
    SavePropList(below, OneEntry(u8"a", 1));
    EXPECT_TRUE(below.Exists());
}

TEST_F(PropListFile, OtherFoldersAreNotMade)
{
    filesupport::Dir::SetPrefDir(filesupport::Dir(mFolder.Dir(), u"zeb"));
    filesupport::File file(mFolder.Dir(), u"zeb2/settings.xml");
    EXPECT_THROW(SavePropList(file, OneEntry(u8"a", 1)), filesupport::file_exception);
    EXPECT_EQ(mFolder.CountFiles(), 0U);
}

TEST_F(PropListFile, FailedSaveNamesTheFileThatTheUserKnows)
{
    filesupport::File file = mFolder.File("settings.xml");
    SavePropList(file, OneEntry(u8"a", 1));
    const std::string before = mFolder.Read("settings.xml");
    for (const int goodWrites : {0, 1, 3})
    {
        const InjectedFault fullDisk([goodWrites](filesupport::FileSystemCalls& system)
                                     { system.mWrite = FailAfter(goodWrites, ENOSPC, system.mWrite); });
        try
        {
            SavePropList(file, LongList());
            ADD_FAILURE() << "a full disk went unnoticed";
        }
        catch (const filesupport::file_delete_exception&)
        {
            ADD_FAILURE() << "the catalogue would swallow this";
        }
        catch (const filesupport::file_exception& failure)
        {
            EXPECT_EQ(failure.Error(), ENOSPC);
            EXPECT_TRUE(failure.Path() == file.FullPath());
        }
        EXPECT_EQ(mFolder.Read("settings.xml"), before);
        EXPECT_EQ(mFolder.CountFiles(), 1U);
    }
}
