#pragma once

#include <boost/function.hpp>

#include <chrono>
#include <memory>

namespace zebcore::threads
{

/// The platform's side of the main-thread loop: tells when a descriptor becomes ready, and waits for that. Internal
/// to the loop. Main thread, except Wake.
class DescriptorPoller
{
public:
    /// report: called inside Poll and Wait, and by the system's own loop where that runs the main thread. It only
    /// takes note.
    explicit DescriptorPoller(boost::function<void(int descriptor)> report);
    DescriptorPoller(const DescriptorPoller&) = delete;
    DescriptorPoller& operator=(const DescriptorPoller&) = delete;
    ~DescriptorPoller();

    /// Makes the descriptor known, anew if it was known: its number may have been closed and given to something else
    /// since. False when the system can't watch it.
    bool Register(int descriptor);
    /// Asks for one report, as soon as a registered descriptor is readable, has an error or has been hung up. Asking
    /// twice is asking once.
    void Await(int descriptor);
    /// The descriptor stays open: it is its owner's.
    void Forget(int descriptor);

    /// Makes the reports that are due, without waiting.
    void Poll();
    /// Waits until there has been a report, Wake is called or the time is over.
    void Wait(std::chrono::nanoseconds longest);
    /// Ends the wait that is under way, or the next one. Where the system's own loop runs the main thread, has it
    /// pump after the delay. [any]
    void Wake(std::chrono::nanoseconds delay);

private:
    class Impl;
    std::unique_ptr<Impl> mImpl;
};

} // namespace zebcore::threads
