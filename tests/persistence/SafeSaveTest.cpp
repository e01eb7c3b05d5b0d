#include "foundation/zebcore/SafeSave.h"

#include "TempFolder.h"

#include "foundation/zebcore/FileExceptions.h"
#include "foundation/zebcore/FileUtils.h"
#include "foundation/zebcore/internal/FileSystemCalls.h"

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

int Fail(int error)
{
    errno = error;
    return -1;
}

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

struct Fault
{
    const char* mName;
    std::function<void(FileSystemCalls&)> mInject;
    int mError;
    bool mIsRefusal;
};

void PrintTo(const Fault& fault, std::ostream* out)
{
    *out << fault.mName;
}

// Fails the calls that follow `good` good ones.
template <typename Result, typename... Arguments>
std::function<Result(Arguments...)> FailAfter(int good, int error, std::function<Result(Arguments...)> call)
{
    return [good, error, call](Arguments... arguments) mutable
    {
        return good-- > 0 ? call(arguments...) : Result{Fail(error)};
    };
}

ssize_t WriteOneByte(int descriptor, const void* data, std::size_t /*size*/)
{
    return write(descriptor, data, 1);
}

using Calls = FileSystemCalls;

const Fault kFaults[] = {
    {"no room for the temporary file", [](Calls& calls) { calls.mOpen = FailAfter(0, ENOSPC, calls.mOpen); }, ENOSPC,
     false},
    {"folder is read-only", [](Calls& calls) { calls.mOpen = FailAfter(0, EROFS, calls.mOpen); }, EROFS, false},
    {"disk full at once", [](Calls& calls) { calls.mWrite = FailAfter(0, ENOSPC, calls.mWrite); }, ENOSPC, false},
    {"disk full after a short write",
     [](Calls& calls)
     { calls.mWrite = FailAfter(1, ENOSPC, std::function<ssize_t(int, const void*, std::size_t)>(WriteOneByte)); },
     ENOSPC, false},
    {"nothing written, no reason given",
     [](Calls& calls)
     {
         calls.mWrite = [](int, const void*, std::size_t)
         {
             return ssize_t{0};
         };
     },
     ENOSPC, false},
    {"quota found out at close",
     [](Calls& calls)
     {
         calls.mClose = [good = 1](int descriptor) mutable
         {
             close(descriptor);
             return good-- > 0 ? 0 : Fail(EDQUOT);
         };
     },
     EDQUOT, false},
    {"flush fails", [](Calls& calls) { calls.mFlush = FailAfter(0, EIO, calls.mFlush); }, EIO, false},
    {"rename fails", [](Calls& calls) { calls.mRename = FailAfter(0, EIO, calls.mRename); }, EIO, false},
    {"rename finds no room", [](Calls& calls) { calls.mRename = FailAfter(0, ENOSPC, calls.mRename); }, ENOSPC,
     false},
    {"old file is immutable", [](Calls& calls) { calls.mRename = FailAfter(0, EPERM, calls.mRename); }, EPERM, true},
    {"old file is another's", [](Calls& calls) { calls.mRename = FailAfter(0, EACCES, calls.mRename); }, EACCES,
     true},
};

class SafeSaveFaults : public SafeSaveTest, public testing::WithParamInterface<Fault>
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

INSTANTIATE_TEST_SUITE_P(Each, SafeSaveFaults, testing::ValuesIn(kFaults));

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
        return ++calls % 2 == 0 ? ssize_t{Fail(EINTR)} : write(descriptor, data, std::min<std::size_t>(size, 3));
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
