#include "foundation/zebcore/Trace.h"
#include "foundation/zebcore/Threads.h"

#include <gtest/gtest.h>

#include <string>
#include <thread>
#include <vector>

using namespace zebcore;
using namespace zebcore::debug;

namespace
{

class TraceTest : public testing::Test
{
protected:
    TraceTest()
    {
        SetAllTraceEnabled(false);
        SetTraceSink([this](std::string_view line) { mLines.emplace_back(line); });
    }
    ~TraceTest() override
    {
        SetTraceSink({});
        SetDebugTraceSink({});
        SetAllTraceEnabled(false);
    }

    std::vector<std::string> mLines;
};

void TraceOnce(int number)
{
    ZEB_TRACE("TraceTest::Once", "number " << number);
}

TEST_F(TraceTest, WritesTheLineInItsForm)
{
    SetTraceCategoryEnabled("TraceTest::Once", true);
    TraceOnce(7);
    const std::string id = std::to_string(threads::GetCurrentThreadID());
    ASSERT_EQ(1U, mLines.size());
    EXPECT_EQ("<" + id + "> <TraceTest::Once> <6> number 7\n", mLines[0]);
}

TEST_F(TraceTest, TakesPathsAndPluginNames)
{
    SetAllTraceEnabled(true);
    ZEB_TRACE("TraceTest::Path", "Path:" << UTF16String{u'/', u'\u00e9', char16_t(0xD83C)} << u8"\u00e9");
    ASSERT_EQ(1U, mLines.size());
    EXPECT_TRUE(mLines[0].ends_with("> Path:/\u00e9\uFFFD\u00e9\n"));
}

TEST_F(TraceTest, LeavesOutZeroUnits)
{
    SetAllTraceEnabled(true);
    ZEB_TRACE("TraceTest::Name", UTF16String{u'a', u'\0', u'\0'} << u'b');
    ASSERT_EQ(1U, mLines.size());
    EXPECT_TRUE(mLines[0].ends_with("> ab\n"));
}

TEST_F(TraceTest, FollowsEachChangeOfTheConfiguration)
{
    struct Step
    {
        void (*mChange)();
        bool mTraces;
    };
    const Step steps[] = {
        {[] {}, false},
        {[] { SetTraceCategoryEnabled("TraceTest::Other", true); }, false},
        {[] { SetTraceCategoryEnabled("TraceTest::Once", true); }, true},
        {[] { SetTraceCategoryEnabled("TraceTest::Once", false); }, false},
        {[] { SetAllTraceEnabled(true); }, true},
        {[] { SetTraceCategoryEnabled("TraceTest::Once", false); }, false},
        {[] { SetAllTraceEnabled(true); }, true},
        {[] { SetAllTraceEnabled(false); }, false},
    };
    for (const Step& step : steps)
    {
        mLines.clear();
        step.mChange();
        TraceOnce(1);
        EXPECT_EQ(step.mTraces, !mLines.empty()) << "step " << &step - steps;
    }
}

TEST_F(TraceTest, CountsChanges)
{
    const std::uint32_t before = TraceChangeCount();
    TraceOnce(1);
    EXPECT_EQ(before, TraceChangeCount());
    SetTraceCategoryEnabled("TraceTest::Once", true);
    EXPECT_NE(before, TraceChangeCount());
}

TEST_F(TraceTest, DoesNotEvaluateAMessageThatIsNotWanted)
{
    int evaluations = 0;
    const auto traceAtOneSite = [&]
    {
        ZEB_TRACE_REALTIME("TraceTest::Lazy", ++evaluations);
    };
    traceAtOneSite();
    EXPECT_EQ(0, evaluations);
    SetTraceCategoryEnabled("TraceTest::Lazy", true);
    traceAtOneSite();
    EXPECT_EQ(1, evaluations);
}

TEST_F(TraceTest, LevelsBeyondTheLibrarysAreOff)
{
    SetAllTraceEnabled(true);
    const auto* category = reinterpret_cast<const unsigned char*>("TraceTest");
    EXPECT_TRUE(TraceEnabled(category, kTraceLevel, true));
    EXPECT_TRUE(TraceEnabled(category, 0, false));
    EXPECT_FALSE(TraceEnabled(category, kTraceLevel + 1, true));
}

TEST_F(TraceTest, DebugOutputIsApartFromTheTrace)
{
    std::string output;
    SetDebugTraceSink([&](std::string_view text) { output += text; });
    DebugTrace(reinterpret_cast<const unsigned char*>("two\nlines\n"));
    EXPECT_EQ("two\nlines\n", output);
    EXPECT_TRUE(mLines.empty());
}

TEST_F(TraceTest, ASinkMayReplaceItself)
{
    SetAllTraceEnabled(true);
    int first = 0;
    int second = 0;
    SetTraceSink(
        [&](std::string_view)
        {
            ++first;
            SetTraceSink([&](std::string_view) { ++second; });
        });
    TraceOnce(1);
    TraceOnce(2);
    EXPECT_EQ(1, first);
    EXPECT_EQ(1, second);
}

TEST_F(TraceTest, ThreadsTraceWhileTheConfigurationChanges)
{
    constexpr int kRounds = 500;
    constexpr int kTracers = 3;
    std::vector<std::thread> tracers;
    tracers.reserve(kTracers);
    for (int i = 0; i < kTracers; ++i)
        tracers.emplace_back(
            []
            {
                for (int round = 0; round < kRounds; ++round)
                    TraceOnce(round);
            });
    for (int round = 0; round < kRounds; ++round)
    {
        SetTraceCategoryEnabled("TraceTest::Once", round % 2 == 0);
        SetTraceCategoryEnabled("TraceTest::Category" + std::to_string(round % 10), true);
    }
    for (std::thread& tracer : tracers)
        tracer.join();

    SetTraceCategoryEnabled("TraceTest::Once", true);
    mLines.clear();
    TraceOnce(1);
    EXPECT_EQ(1U, mLines.size());
}

} // namespace
