#include "tests/support/RealtimeGuardInternal.h"

#include <algorithm>
#include <array>
#include <atomic>
#include <cstdlib>
#include <execinfo.h>
#include <iostream>
#include <memory>
#include <sstream>

namespace realtimeguard
{

namespace
{

constexpr std::size_t kKinds = 6;
constexpr std::size_t kMaxStacks = 6;
constexpr int kMaxFrames = 24;

struct Stack
{
    Violation violation = Violation::Allocation;
    std::array<void*, kMaxFrames> frames{};
    std::atomic<int> frameCount{0};
};

constinit std::array<std::atomic<unsigned long>, kKinds> sCounts{};
constinit std::atomic<std::size_t> sStackCount{0};
std::array<Stack, kMaxStacks> sStacks;

constinit thread_local int sDepth = 0;
constinit thread_local bool sRecording = false; // The stack walk must not report itself

// The first walk of a process loads a library, so it is done ahead of all sections.
[[maybe_unused]] const int sWarmUp = []
{
    std::array<void*, 4> frames{};
    return backtrace(frames.data(), static_cast<int>(frames.size()));
}();

const char* NameOf(Violation violation)
{
    constexpr std::array<const char*, kKinds> kNames{"allocation",  "free",       "lock",
                                                     "system call", "page fault", "voluntary switch"};
    return kNames[static_cast<std::size_t>(violation)];
}

void KeepStack(Violation violation) noexcept
{
    const std::size_t index = sStackCount.fetch_add(1, std::memory_order_relaxed);
    if (index >= kMaxStacks)
        return;
    Stack& stack = sStacks[index];
    stack.violation = violation;
    stack.frameCount.store(backtrace(stack.frames.data(), kMaxFrames), std::memory_order_release);
}

void WriteStack(std::ostream& out, const Stack& stack)
{
    const int frames = stack.frameCount.load(std::memory_order_acquire);
    const std::unique_ptr<char*, decltype(&std::free)> names(backtrace_symbols(stack.frames.data(), frames),
                                                             &std::free);
    out << NameOf(stack.violation) << ":\n";
    for (int i = 0; names && i < frames; ++i)
        out << "    " << names.get()[i] << '\n';
}

} // namespace

Section::Section()
{
    if (sDepth++ == 0)
        ArmSystemCallTrap();
}

Section::~Section()
{
    if (--sDepth == 0)
        DisarmSystemCallTrap();
}

void Record(Violation violation) noexcept
{
    if (sDepth == 0 || sRecording)
        return;
    sRecording = true;
    sCounts[static_cast<std::size_t>(violation)].fetch_add(1, std::memory_order_relaxed);
    KeepStack(violation);
    sRecording = false;
}

void RecordUsage(Violation violation, long count) noexcept
{
    sCounts[static_cast<std::size_t>(violation)].fetch_add(static_cast<unsigned long>(count),
                                                           std::memory_order_relaxed);
}

bool IsActive()
{
    return ZEB_GUARD_INTERPOSES != 0;
}

bool AnnounceWhatIsMissing()
{
    const bool all = IsActive() && CatchesSystemCalls();
    static const bool sSaid = [all]
    {
        if (!IsActive())
            std::cerr
                << "*** The realtime guard sees NOTHING in this build: sanitizers, or a system without its nets.\n";
        else if (!all)
            std::cerr << "*** The realtime guard can't see system calls: the kernel does not hand them over.\n";
        return true;
    }();
    return sSaid && all;
}

unsigned long Count(Violation violation)
{
    return sCounts[static_cast<std::size_t>(violation)].load(std::memory_order_relaxed);
}

unsigned long CountAll()
{
    unsigned long sum = 0;
    for (const auto& count : sCounts)
        sum += count.load(std::memory_order_relaxed);
    return sum;
}

std::string Report()
{
    std::ostringstream text;
    for (std::size_t kind = 0; kind < kKinds; ++kind)
        text << NameOf(static_cast<Violation>(kind)) << ": " << Count(static_cast<Violation>(kind)) << '\n';
    const std::size_t stacks = std::min(sStackCount.load(std::memory_order_relaxed), kMaxStacks);
    for (std::size_t i = 0; i < stacks; ++i)
        WriteStack(text, sStacks[i]);
    return text.str();
}

void Reset()
{
    for (auto& count : sCounts)
        count.store(0, std::memory_order_relaxed);
    for (Stack& stack : sStacks)
        stack.frameCount.store(0, std::memory_order_relaxed);
    sStackCount.store(0, std::memory_order_relaxed);
}

} // namespace realtimeguard
