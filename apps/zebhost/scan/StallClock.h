#pragma once

#include <chrono>

namespace zebhost
{

// Tells when nothing has happened for too long. Counts only time in which this process ran itself, so that nobody is
// blamed for a computer that was suspended or a program that was stopped.
class StallClock
{
public:
    // 0 seconds never expire.
    explicit StallClock(double seconds);

    void Restart();
    // To be called every now and then, more often than every quarter of a second.
    void Tick();
    bool HasExpired() const;

private:
    using Clock = std::chrono::steady_clock;

    std::chrono::duration<double> mLimit;
    std::chrono::duration<double> mCounted{0};
    Clock::time_point mLast = Clock::now();
};

} // namespace zebhost
