#include "foundation/zebcore/SafeSave.h"

#include "TempFolder.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "tests/persistence/SaveFaults.h"

#include <gtest/gtest.h>

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <functional>

using namespace zebcore;
using namespace zebcore::filesupport;

namespace
{

class SafeSaveTest : public testing::Test
{
protected:
    void TearDown() override { FileSystem() = FileSystemCalls(); }

    static void Save(File target, const UTF8String& text)
    {
        SafeSave save(target);
        utility::FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(), text);
        save.Commit();
    }

    const TempFolder mFolder;
};

class SafeSaveFaults : public SafeSaveTest, public testing::WithParamInterface<SaveFault>
{
};

} // namespace

TEST_P(SafeSaveFaults, LeaveTheOldFileAndNothingElse)
{
    mFolder.Write("settings.xml", "old");
    GetParam().mInject(FileSystem());
    try
    {
        Save(mFolder.File("settings.xml"), u8"something new");
        ADD_FAILURE() << "the failure went unnoticed";
    }
    catch (const file_exception& failure)
    {
        EXPECT_EQ(failure.Error(), GetParam().mError);
        EXPECT_NE(std::string(failure.what()).find(mFolder.Path("settings.xml").string()), std::string::npos);
        EXPECT_EQ(dynamic_cast<const file_delete_exception*>(&failure) != nullptr, GetParam().mIsRefusal);
    }
    EXPECT_EQ(mFolder.Read("settings.xml"), "old");
    EXPECT_EQ(mFolder.CountFiles(), 1U);
}

TEST_P(SafeSaveFaults, OfAFirstSaveLeaveNothing)
{
    GetParam().mInject(FileSystem());
    try
    {
        Save(mFolder.File("settings.xml"), u8"something new");
        ADD_FAILURE() << "the failure went unnoticed";
    }
    catch (const file_exception& failure)
    {
        EXPECT_EQ(dynamic_cast<const file_delete_exception*>(&failure), nullptr) << "there is no file to give up";
    }
    EXPECT_EQ(mFolder.CountFiles(), 0U);
}

INSTANTIATE_TEST_SUITE_P(Each, SafeSaveFaults, testing::ValuesIn(SaveFaults()));

TEST_F(SafeSaveTest, CommitReplacesTheFile)
{
    mFolder.Write("a", "old");
    Save(mFolder.File("a"), u8"new");
    Save(mFolder.File("b"), u8"first");
    EXPECT_EQ(mFolder.Read("a"), "new");
    EXPECT_EQ(mFolder.Read("b"), "first");
    EXPECT_EQ(mFolder.CountFiles(), 2U);
}

TEST_F(SafeSaveTest, WithoutCommitTheFileStaysAsItWas)
{
    mFolder.Write("a", "old");
    {
        File target = mFolder.File("a");
        SafeSave save(target);
        utility::FileUtils::SimpleWriteStringToFile(save.GetTempFile().FullPath(), u8"new");
        EXPECT_TRUE(save.GetTempFile().Exists());
    }
    EXPECT_EQ(mFolder.Read("a"), "old");
    EXPECT_EQ(mFolder.CountFiles(), 1U);
}

TEST_F(SafeSaveTest, SecondCommitDoesNothing)
{
    File target = mFolder.File("a");
    SafeSave save(target);
    save.Commit();
    mFolder.Write("a", "written by another");
    save.Commit();
    EXPECT_EQ(mFolder.Read("a"), "written by another");
}

TEST_F(SafeSaveTest, ShortAndInterruptedWritesAreCarriedOn)
{
    int calls = 0;
    FileSystem().mWrite = [&calls](int descriptor, const void* data, std::size_t size)
    {
        if (++calls % 2 != 0)
            return write(descriptor, data, std::min<std::size_t>(size, 3));
        errno = EINTR;
        return ssize_t{-1};
    };
    Save(mFolder.File("a"), u8"ten letters");
    EXPECT_EQ(mFolder.Read("a"), "ten letters");
}

TEST_F(SafeSaveTest, ContentIsFlushedBeforeTheRenameAndTheFolderAfterIt)
{
    std::string order;
    FileSystemCalls& calls = FileSystem();
    calls.mFlush = [&order](int descriptor)
    {
        struct stat status = {};
        fstat(descriptor, &status);
        order += S_ISDIR(status.st_mode) ? "folder " : "file ";
        return 0;
    };
    calls.mRename = [&order, rename = calls.mRename](const char* from, const char* to)
    {
        order += "rename ";
        return rename(from, to);
    };
    Save(mFolder.File("a"), u8"x");
    EXPECT_EQ(order, "file rename folder ");
}

TEST_F(SafeSaveTest, FailingFlushOfTheFolderIsToldAndKeepsTheNewFile)
{
    mFolder.Write("a", "old");
    FileSystem().mFlush = FailAfter(1, EIO, FileSystem().mFlush);
    EXPECT_THROW(Save(mFolder.File("a"), u8"new"), file_exception);
    EXPECT_EQ(mFolder.Read("a"), "new");
    EXPECT_EQ(mFolder.CountFiles(), 1U);
    FileSystem().mFlush = FailAfter(1, EINVAL, FileSystemCalls().mFlush);
    EXPECT_NO_THROW(Save(mFolder.File("a"), u8"newer")) << "a file system that can't flush folders";
}

TEST_F(SafeSaveTest, PermissionsOfTheOldFileAreKept)
{
    struct stat status = {};
    for (const mode_t mode : {0600U, 0640U, 0444U})
    {
        mFolder.Write("a", "old");
        chmod(mFolder.Path("a").c_str(), mode);
        Save(mFolder.File("a"), u8"new");
        ASSERT_EQ(stat(mFolder.Path("a").c_str(), &status), 0);
        EXPECT_EQ(status.st_mode & 07777U, mode);
        EXPECT_EQ(mFolder.Read("a"), "new");
        std::filesystem::remove(mFolder.Path("a"));
    }
    const mode_t mask = umask(027);
    Save(mFolder.File("fresh"), u8"x");
    umask(mask);
    ASSERT_EQ(stat(mFolder.Path("fresh").c_str(), &status), 0);
    EXPECT_EQ(status.st_mode & 07777U, 0640U);
}

TEST_F(SafeSaveTest, LinkStaysALinkAndItsTargetIsReplaced)
{
    std::filesystem::create_directory(mFolder.Path("real"));
    mFolder.Write("real/a", "old");
    std::filesystem::create_symlink("real/a", mFolder.Path("relative"));
    std::filesystem::create_symlink(mFolder.Path("relative"), mFolder.Path("link"));
    Save(mFolder.File("link"), u8"new");
    EXPECT_TRUE(std::filesystem::is_symlink(mFolder.Path("link")));
    EXPECT_TRUE(std::filesystem::is_symlink(mFolder.Path("relative")));
    EXPECT_EQ(mFolder.Read("real/a"), "new");
    std::filesystem::create_symlink("real/b", mFolder.Path("dangling"));
    Save(mFolder.File("dangling"), u8"first");
    EXPECT_EQ(mFolder.Read("real/b"), "first");
}

TEST_F(SafeSaveTest, OnlyRegularFilesAreReplaced)
{
    std::filesystem::create_directory(mFolder.Path("folder"));
    ASSERT_EQ(mkfifo(mFolder.Path("pipe").c_str(), 0600), 0);
    std::filesystem::create_symlink("loop", mFolder.Path("loop"));
    for (const char* const name : {"folder", "pipe", "loop", "missing/a", "pipe/a"})
    {
        EXPECT_THROW(Save(mFolder.File(name), u8"x"), file_exception) << name;
        EXPECT_EQ(mFolder.CountFiles(), 3U) << name;
    }
    EXPECT_THROW(Save(File(u""), u8"x"), file_exception);
    EXPECT_THROW(Save(File(UTF16String(u"/tmp/a\0b", 8)), u8"x"), file_exception);
}

TEST_F(SafeSaveTest, NamesOfAnyLengthAndBytes)
{
    const std::string names[] = {std::string(255, 'n'), "\xFF\xC3 not UTF-8", "a'b \\ \n"};
    for (const std::string& name : names)
    {
        Save(mFolder.File(name), u8"x");
        EXPECT_EQ(mFolder.Read(name), "x");
    }
    EXPECT_EQ(mFolder.CountFiles(), std::size(names));
}

TEST_F(SafeSaveTest, WhatKilledSavesLeftBehindIsRemoved)
{
    const pid_t child = fork();
    if (child == 0)
        _exit(0);
    ASSERT_EQ(waitpid(child, nullptr, 0), child); // nobody has its number any more
    const std::string dead = std::to_string(child);
    const std::string own = std::to_string(getpid());
    for (const std::string& name : {"a.tmp-" + dead + "-1", "a.tmp-" + own + "-999999", std::string("a.tmp-notes"),
                                    "a.tmp-" + dead + "-1-notes", "b.tmp-" + dead + "-1"})
    {
        mFolder.Write(name, "x");
        std::filesystem::last_write_time(mFolder.Path(name),
                                         std::filesystem::file_time_type::clock::now() - std::chrono::hours(1));
    }
    mFolder.Write("a.tmp-" + dead + "-2", "young: perhaps of another machine");
    Save(mFolder.File("a"), u8"x");
    EXPECT_FALSE(std::filesystem::exists(mFolder.Path("a.tmp-" + dead + "-1")));
    EXPECT_EQ(mFolder.CountFiles(), 6U);
}
