#include "CrashNote.h"

#include <algorithm>
#include <array>
#include <csignal>
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

void OnSignal(int signal)
{
    const std::string_view what = signal == SIGALRM ? "soak: HANGS: " : "soak: CRASHED: ";
    [[maybe_unused]] ssize_t written = write(sDescriptor, what.data(), what.size());
    written = write(sDescriptor, sText.data(), sLength);
    _exit(1);
}

} // namespace

CrashNote::CrashNote(int descriptor, std::uint64_t randomStart) : mRandomStart(randomStart)
{
    sDescriptor = descriptor;
    struct sigaction action
    {
    };
    action.sa_handler = OnSignal;
    sigfillset(&action.sa_mask);
    for (const int signal : {SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGABRT, SIGTRAP, SIGALRM})
    {
        sigaction(signal, &action, nullptr);
    }
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
