#include "module/ModuleUITimer.h"

#include "foundation/zebcore/MainThreadLoop.h"
#include "utility/ThreadUtils.h"

#include <boost/signals2/connection.hpp>
#include <gtest/gtest.h>

#include <stdexcept>

namespace zebaudiofilterhost
{
namespace
{

class ModuleUITimerTest : public ::testing::Test
{
protected:
    ModuleUITimerTest()
    {
        InitializeMainThreadID();
        zebcore::threads::SetMainThreadClock([this] { return mNow; });
    }

    ~ModuleUITimerTest() override
    {
        Advance(20); // Lets a pending tick find the signal empty and stop the timer
        zebcore::threads::SetMainThreadClock({});
    }

    bool Advance(unsigned int milliseconds)
    {
        mNow += milliseconds * 1000000ULL;
        return zebcore::threads::PumpMainThread();
    }

    boost::signals2::connection Connect()
    {
        return ModuleUITimer::GetInstance().ConnectTick([this] { ++mTicks; });
    }

    unsigned long long mNow = 1;
    int mTicks = 0;
};

TEST_F(ModuleUITimerTest, TicksTwentyMillisecondsAfterTheTickBefore)
{
    const boost::signals2::scoped_connection connection = Connect();
    Advance(19);
    EXPECT_EQ(mTicks, 0);
    Advance(1);
    EXPECT_EQ(mTicks, 1);
    Advance(100); // Late: what was missed is not made up for
    EXPECT_EQ(mTicks, 2);
    Advance(19);
    EXPECT_EQ(mTicks, 2);
    Advance(1);
    EXPECT_EQ(mTicks, 3);
}

TEST_F(ModuleUITimerTest, ASecondSlotQueuesNoSecondTick)
{
    const boost::signals2::scoped_connection first = Connect();
    const boost::signals2::scoped_connection second = Connect();
    Advance(20);
    EXPECT_EQ(mTicks, 2);
    EXPECT_FALSE(Advance(19));
}

TEST_F(ModuleUITimerTest, StopsWithoutSlotsAndStartsAgain)
{
    Connect().disconnect();
    EXPECT_TRUE(Advance(20));
    EXPECT_FALSE(Advance(1000));

    const boost::signals2::scoped_connection again = Connect();
    Advance(20);
    EXPECT_EQ(mTicks, 1);
}

TEST_F(ModuleUITimerTest, ThePendingTickServesASlotConnectedMeanwhile)
{
    Connect().disconnect();
    Advance(15);
    const boost::signals2::scoped_connection late = Connect();
    Advance(5);
    EXPECT_EQ(mTicks, 1);
}

TEST_F(ModuleUITimerTest, ASlotThatDisconnectsItselfLeavesOneMoreTick)
{
    boost::signals2::connection connection;
    connection = ModuleUITimer::GetInstance().ConnectTick(
        [&]
        {
            ++mTicks;
            connection.disconnect();
        });
    Advance(20);
    EXPECT_TRUE(Advance(20)); // Finds the signal empty
    EXPECT_EQ(mTicks, 1);
    EXPECT_FALSE(Advance(20));
}

TEST_F(ModuleUITimerTest, AThrowingSlotDoesNotStopTheClock)
{
    const boost::signals2::scoped_connection good = Connect();
    boost::signals2::scoped_connection bad =
        ModuleUITimer::GetInstance().ConnectTick([] { throw std::runtime_error("slot"); });
    EXPECT_THROW(Advance(20), std::runtime_error);
    bad.disconnect();
    Advance(20);
    EXPECT_EQ(mTicks, 2);
}

} // namespace
} // namespace zebaudiofilterhost
