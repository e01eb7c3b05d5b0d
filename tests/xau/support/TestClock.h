#pragma once

#include "foundation/zebcore/MainThreadLoop.h"
#include "utility/ThreadUtils.h"

namespace zebaudiofilterhost::xau
{

// The main-thread loop by a clock that stands still but for Pass.
class TestClock
{
public:
    TestClock()
    {
        InitializeMainThreadID();
        zebcore::threads::SetMainThreadClock([this] { return mNow; });
    }
    ~TestClock() { zebcore::threads::SetMainThreadClock({}); }
    TestClock(const TestClock&) = delete;
    TestClock& operator=(const TestClock&) = delete;

    // Lets so much time go by, and does what is due by then.
    void Pass(unsigned int milliseconds)
    {
        mNow += milliseconds * 1'000'000ULL;
        zebcore::threads::PumpMainThread();
    }

private:
    unsigned long long mNow = 1'000'000'000;
};

} // namespace zebaudiofilterhost::xau
