#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/Threads.h"
#include "foundation/zebcore/internal/MainThreadQueue.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/socket.h>
#include <unistd.h>

#include <algorithm>
#include <filesystem>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

using namespace zebcore::threads;

namespace
{

/// Two connected descriptors.
class Pair
{
public:
    Pair() { EXPECT_EQ(0, socketpair(AF_UNIX, SOCK_STREAM | SOCK_NONBLOCK, 0, mEnds)); }
    Pair(const Pair&) = delete;
    Pair& operator=(const Pair&) = delete;
    ~Pair()
    {
        Close(0);
        Close(1);
    }

    int Watched() const { return mEnds[0]; }
    void Send() const { EXPECT_EQ(1, write(mEnds[1], "x", 1)); }
    void Close(int end)
    {
        if (mEnds[end] >= 0)
            close(mEnds[end]);
        mEnds[end] = -1;
    }

private:
    int mEnds[2] = {-1, -1};
};

void ReadOne(int descriptor)
{
    char byte = 0;
    EXPECT_EQ(1, read(descriptor, &byte, 1));
}

class DescriptorWatchTest : public testing::Test
{
protected:
    ~DescriptorWatchTest() override
    {
        for (const WatchID watch : mWatches)
            RemoveDescriptorWatch(watch);
    }

    WatchID Watch(int descriptor, boost::function<void(int)> handler)
    {
        mWatches.push_back(AddDescriptorWatch(descriptor, std::move(handler)));
        EXPECT_NE(kNoWatch, mWatches.back());
        return mWatches.back();
    }
    WatchID Note(int descriptor, char name)
    {
        return Watch(descriptor, [this, name](int) { mRan += name; });
    }
    std::string RanNow()
    {
        mRan.clear();
        PumpMainThread();
        return mRan;
    }

    std::string mRan;
    std::vector<WatchID> mWatches;
};

TEST_F(DescriptorWatchTest, CallsAsLongAsThereIsSomethingToRead)
{
    const Pair pair;
    int given = -1;
    Watch(pair.Watched(),
          [&](int descriptor)
          {
              given = descriptor;
              mRan += 'a';
          });
    EXPECT_EQ("", RanNow());
    pair.Send();
    EXPECT_EQ("a", RanNow());
    EXPECT_EQ("a", RanNow()) << "nobody has read it yet";
    EXPECT_EQ(pair.Watched(), given);
    ReadOne(pair.Watched());
    RanNow(); // May still tell of the byte that has gone.
    EXPECT_EQ("", RanNow());
    pair.Send();
    EXPECT_EQ("a", RanNow());
}

TEST_F(DescriptorWatchTest, AHangUpWakesAHandler)
{
    Pair pair;
    Note(pair.Watched(), 'h');
    EXPECT_EQ("", RanNow());
    pair.Close(1);
    EXPECT_EQ("h", RanNow());
}

TEST_F(DescriptorWatchTest, AnErrorWakesAHandler)
{
    int ends[2];
    ASSERT_EQ(0, pipe(ends));
    Note(ends[1], 'e'); // The writing end never becomes readable; losing its reader is its error.
    EXPECT_EQ("", RanNow());
    close(ends[0]);
    EXPECT_EQ("e", RanNow());
    RemoveDescriptorWatch(mWatches.back());
    close(ends[1]);
}

TEST_F(DescriptorWatchTest, WatchesShareADescriptor)
{
    const Pair pair;
    Note(pair.Watched(), 'a');
    const WatchID second = Note(pair.Watched(), 'b');
    Note(pair.Watched(), 'a');
    pair.Send();
    EXPECT_EQ("aba", RanNow());
    RemoveDescriptorWatch(second);
    EXPECT_EQ("aa", RanNow());
}

TEST_F(DescriptorWatchTest, WatchesMayBeRemovedFromInsideAHandler)
{
    const Pair pair;
    const auto payload = std::make_shared<int>(0);
    WatchID self = kNoWatch;
    WatchID next = kNoWatch;
    self = Watch(pair.Watched(),
                 [&, payload](int)
                 {
                     RemoveDescriptorWatch(self);
                     RemoveDescriptorWatch(next);
                     ++*payload;
                 });
    next = Note(pair.Watched(), 'n');
    pair.Send();
    EXPECT_EQ("", RanNow());
    EXPECT_EQ("", RanNow());
    EXPECT_EQ(1, *payload);
    EXPECT_EQ(1, payload.use_count());
}

TEST_F(DescriptorWatchTest, WatchesMayBeAddedFromInsideAHandler)
{
    const Pair first;
    const Pair second;
    bool added = false;
    second.Send();
    Watch(first.Watched(),
          [&](int descriptor)
          {
              mRan += 'a';
              if (added)
                  return;
              added = true;
              Note(descriptor, 'b');
              Note(second.Watched(), 'c');
          });
    first.Send();
    EXPECT_EQ("a", RanNow());
    std::string ran = RanNow();
    std::sort(ran.begin(), ran.end());
    EXPECT_EQ("abc", ran);
}

TEST_F(DescriptorWatchTest, ANestedPumpServesOtherDescriptorsOnly)
{
    const Pair first;
    const Pair second;
    int depth = 0;
    int deepest = 0;
    Watch(first.Watched(),
          [&](int descriptor)
          {
              deepest = std::max(deepest, ++depth);
              second.Send();
              PumpMainThread();
              PumpMainThread();
              ReadOne(descriptor);
              --depth;
          });
    Watch(second.Watched(),
          [&](int descriptor)
          {
              ReadOne(descriptor);
              mRan += 's';
          });
    first.Send();
    EXPECT_EQ("s", RanNow());
    EXPECT_EQ(1, deepest);
}

TEST_F(DescriptorWatchTest, APumpInsideTheSystemsLoopLeavesThePollingToIt)
{
    const Pair reported;
    const Pair ready;
    Watch(reported.Watched(),
          [&](int descriptor)
          {
              ReadOne(descriptor);
              ready.Send();
              AsyncCallFromMainThread([this] { mRan += 'c'; }, 0);
              PumpInsideSystemLoop();
              mRan += '1';
          });
    Note(reported.Watched(), '2');
    Note(ready.Watched(), '3');
    reported.Send();
    EXPECT_EQ("c21", RanNow());
    EXPECT_EQ("3", RanNow());
}

TEST_F(DescriptorWatchTest, AHandlerThatThrowsSilencesNobody)
{
    const Pair pair;
    Watch(pair.Watched(),
          [&](int)
          {
              mRan += 't';
              throw std::runtime_error("handler");
          });
    Note(pair.Watched(), 'a');
    pair.Send();
    for (int round = 0; round < 2; ++round)
    {
        mRan.clear();
        EXPECT_THROW(PumpMainThread(), std::runtime_error);
        EXPECT_EQ("t", mRan);
        EXPECT_EQ("a", RanNow());
    }
}

TEST_F(DescriptorWatchTest, AReusedNumberIsADescriptorOfItsOwn)
{
    Pair first;
    const int number = first.Watched();
    Note(number, 'o');
    first.Close(0); // Before its watch is removed: bad manners, but plug-ins have them.
    const int reused = fcntl(STDIN_FILENO, F_DUPFD, number);
    if (reused == number)
        close(reused);
    const Pair second;
    ASSERT_EQ(number, dup2(second.Watched(), number));
    Note(number, 'n');
    second.Send();
    EXPECT_EQ("on", RanNow());
    for (const WatchID watch : mWatches)
        RemoveDescriptorWatch(watch);
    close(number);
}

TEST_F(DescriptorWatchTest, RemovingLeavesTheDescriptorOpen)
{
    const Pair pair;
    RemoveDescriptorWatch(Note(pair.Watched(), 'a'));
    EXPECT_NE(-1, fcntl(pair.Watched(), F_GETFD));
    RemoveDescriptorWatch(kNoWatch);
    pair.Send();
    EXPECT_EQ("", RanNow());
}

TEST_F(DescriptorWatchTest, WhatCantBeWatchedIsRefused)
{
    EXPECT_EQ(kNoWatch, AddDescriptorWatch(-1, [](int) {}));
    for (const std::filesystem::path& path :
         {std::filesystem::temp_directory_path(), std::filesystem::path("/proc/self/exe"),
          std::filesystem::path("/dev/null"), std::filesystem::path("/dev/zero")})
    {
        const int descriptor = open(path.c_str(), O_RDONLY);
        ASSERT_NE(-1, descriptor) << path;
        EXPECT_EQ(kNoWatch, AddDescriptorWatch(descriptor, [](int) {})) << path;
        close(descriptor);
        EXPECT_EQ(kNoWatch, AddDescriptorWatch(descriptor, [](int) {})) << path;
    }
}

// A plug-in that reads whole messages from a blocking descriptor relies on waiting for their second half.
TEST_F(DescriptorWatchTest, ABlockingDescriptorStaysSo)
{
    for (const int flag : {0, O_NONBLOCK})
    {
        int ends[2];
        ASSERT_EQ(0, pipe2(ends, flag));
        const auto expectFlag = [&]
        {
            EXPECT_EQ(flag, fcntl(ends[0], F_GETFL) & O_NONBLOCK);
        };
        Watch(ends[0],
              [&](int descriptor)
              {
                  expectFlag();
                  ReadOne(descriptor);
              });
        expectFlag();
        ASSERT_EQ(1, write(ends[1], "x", 1));
        RanNow();
        expectFlag();
        RemoveDescriptorWatch(mWatches.back());
        expectFlag();
        close(ends[0]);
        close(ends[1]);
    }
}

// What comes to a number that has been closed while a duplicate of it lives on.
TEST_F(DescriptorWatchTest, ADuplicateOfAClosedDescriptorWakesNobody)
{
    for (const bool isRemoved : {true, false})
    {
        Pair first;
        const int number = first.Watched();
        const WatchID old = Note(number, 'o');
        EXPECT_EQ("", RanNow());
        const int duplicate = dup(number);
        first.Close(0);
        if (isRemoved)
            RemoveDescriptorWatch(old);
        const Pair second;
        ASSERT_EQ(number, second.Watched()) << "the lowest number is taken";
        if (isRemoved)
            Note(number, 'n');
        first.Send();
        EXPECT_EQ("", RanNow());
        EXPECT_EQ("", RanNow());
        second.Send();
        EXPECT_EQ(isRemoved ? "n" : "o", RanNow());
        for (const WatchID watch : mWatches)
            RemoveDescriptorWatch(watch);
        close(duplicate);
    }
}

TEST_F(DescriptorWatchTest, ADescriptorEndsAWait)
{
    const Pair pair;
    bool called = false;
    Watch(pair.Watched(),
          [&](int descriptor)
          {
              ReadOne(descriptor);
              called = true;
          });
    pair.Send();
    EXPECT_TRUE(RunMainThreadUntil([&] { return called; }, 60'000));
}

} // namespace
