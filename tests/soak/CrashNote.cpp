#include "CrashNote.h"

#include <algorithm>
#include <array>
#include <csignal>
#include <cstddef>
#include <cstring>
#include <string_view>

#include <unistd.h>

namespace soak
{

namespace
{

constexpr unsigned int kLongestSeconds = 120;

// A signal handler can use nothing but memory that is there already.
std::array<char, 512> sText;
std::size_t sLength = 0;
int sDescriptor = -1;

void Write(std::string_view text)
{
    [[maybe_unused]] const ssize_t written = write(sDescriptor, text.data(), text.size());
}

void OnSignal(int signal)
{
    Write(signal == SIGALRM ? "soak: HANGS" : "soak: CRASHED (");
    if (signal != SIGALRM)
    {
        Write(sigdescr_np(signal)); // a constant text, unlike strsignal's
        Write(")");
    }
    Write(": ");
    Write({sText.data(), sLength});
    _exit(1);
}

} // namespace

void UseSignalStack()
{
    constexpr std::size_t kBytes = 0x10000;
    thread_local std::array<std::byte, kBytes> memory;
    stack_t stack{};
    if (sigaltstack(nullptr, &stack) == 0 && (stack.ss_flags & SS_DISABLE) == 0)
    {
        return; // a sanitizer's, which it takes down itself
    }
    stack = {};
    stack.ss_sp = memory.data();
    stack.ss_size = memory.size();
    sigaltstack(&stack, nullptr);
}

CrashNote::CrashNote(int descriptor, std::uint64_t randomStart) : mRandomStart(randomStart)
{
    sDescriptor = descriptor;
    struct sigaction action
    {
    };
    action.sa_handler = OnSignal;
    action.sa_flags = SA_ONSTACK;
    sigfillset(&action.sa_mask);
    for (const int signal : {SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGTRAP, SIGALRM})
    {
        sigaction(signal, &action, nullptr);
    }
    UseSignalStack();
}

void CrashNote::Step(const std::string& name, const char* operation, unsigned long number)
{
    const std::string text = name + ", " + operation + ", operation " + std::to_string(number) + ", random start " +
                             std::to_string(mRandomStart) + "\n";
    sLength = std::min(text.size(), sText.size());
    std::copy_n(text.begin(), sLength, sText.begin());
    alarm(kLongestSeconds);
}

void CrashNote::Done()
{
    Step("at the end", "nothing", 0);
    alarm(0);
}

} // namespace soak
