#pragma once

#include <condition_variable>
#include <exception>
#include <functional>
#include <mutex>
#include <thread>

namespace soak
{

/// The application's audio thread: one for the whole run, which takes denormal numbers as zero.
class ProcessThread
{
public:
    ProcessThread();
    ~ProcessThread();
    ProcessThread(const ProcessThread&) = delete;
    ProcessThread& operator=(const ProcessThread&) = delete;

    /// Runs the work there, and the main thread's loop here, until the work is done. Throws what the work throws,
    /// else LoopError for what came out of the loop. [main]
    void Run(const std::function<void()>& work);

private:
    void Serve();
    void DoWork();
    bool IsDoneWithin(unsigned int milliseconds);

    std::mutex mMutex;
    std::condition_variable mChanged;
    std::function<void()> mWork; // empty when there is none
    std::exception_ptr mThrown;  // by the last work
    bool mEnds = false;
    std::thread mThread;
};

} // namespace soak
