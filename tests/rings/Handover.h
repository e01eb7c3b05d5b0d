#pragma once

#include <atomic>
#include <functional>
#include <thread>

namespace zebaudiofilterhost::testing
{

/// One thing after the other, on a thread each, ordered in time and not in the memory model: what the second sees of
/// the first it owes to the class under test.
inline void DoOnTwoThreads(const std::function<void()>& first, const std::function<void()>& second)
{
    std::atomic<bool> done{false};
    const std::jthread other(
        [&]
        {
            first();
            done.store(true, std::memory_order_relaxed);
        });
    while (!done.load(std::memory_order_relaxed))
        std::this_thread::yield();
    second(); // Before the other is joined, which would order everything
}

} // namespace zebaudiofilterhost::testing
