#include "host/src/XAU/linux/src/CFRunLoopObject.h"
#include "tests/xau/support/TestClock.h"

#include <AudioToolbox/AudioUnitUtilities.h>
#include <gtest/gtest.h>

#include <memory>
#include <thread>

namespace zebaudiofilterhost::xau
{
namespace
{

void Ignore(void*, void*, const AudioUnitEvent*, UInt64, Float32)
{
}

class RunLoopTest : public testing::Test
{
protected:
    // A thread that leaves a timer to its loop, and ends. What it keeps goes with the loop.
    template <typename Call>
    void RunThread(const Call& call)
    {
        std::thread(
            [&]
            {
                const auto kept = std::make_shared<int>();
                mKept = kept;
                CFRunLoopGetCurrent()->AddTimer(std::chrono::hours(1), [kept] {});
                call();
            })
            .join();
    }

    TestClock mClock;
    std::weak_ptr<int> mKept;
};

TEST_F(RunLoopTest, GoesWithItsThread)
{
    RunThread([] {});
    EXPECT_TRUE(mKept.expired());
}

TEST_F(RunLoopTest, StaysForAListenerThatOutlivesTheThread)
{
    AUEventListenerRef listener = nullptr;
    RunThread(
        [&listener]
        {
            EXPECT_EQ(AUEventListenerCreate(Ignore, nullptr, nullptr, kCFRunLoopDefaultMode, 0.05F, 0.0F, &listener),
                      noErr);
        });
    ASSERT_FALSE(mKept.expired());
    EXPECT_EQ(AUListenerDispose(listener), noErr);
    EXPECT_TRUE(mKept.expired());
}

TEST_F(RunLoopTest, StaysForWhoeverRetainsIt)
{
    CFRunLoopRef loop = nullptr;
    RunThread([&loop] { CFRetain(loop = CFRunLoopGetCurrent()); });
    ASSERT_FALSE(mKept.expired());
    CFRelease(loop);
    EXPECT_TRUE(mKept.expired());
}

} // namespace
} // namespace zebaudiofilterhost::xau
