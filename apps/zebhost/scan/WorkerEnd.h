#pragma once

#include <string>

namespace zebhost
{

// The exit status of a worker that finds its connection to the scan gone.
inline constexpr int kChannelLost = 113;

// How a worker process ended.
struct WorkerEnd
{
    enum class Kind
    {
        Exited,
        Signalled,
        Disconnected // it lived on, but without its connection to the scan, or with nonsense on it
    };
    Kind kind = Kind::Exited;
    int value = 0; // exit status or signal

    // By one of the signals that people send to programs they want to end.
    bool IsByUser() const;
    // "crashed: SIGSEGV (segmentation fault)": what the plug-in did, to follow its path.
    std::string Describe() const;
};

} // namespace zebhost
