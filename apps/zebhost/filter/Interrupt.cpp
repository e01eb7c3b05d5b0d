#include "filter/Interrupt.h"

#include <atomic>
#include <csignal>
#include <initializer_list>

namespace zebhost::interrupt
{

namespace
{

std::atomic<bool> sRequested{false};

void OnSignal(int)
{
    sRequested.store(true);
}

} // namespace

void Watch(Second second)
{
    struct sigaction action
    {
    };
    action.sa_handler = OnSignal;
    action.sa_flags = second == Second::Ignored ? 0 : static_cast<int>(SA_RESETHAND);
    sigemptyset(&action.sa_mask);
    for (const int signal : {SIGINT, SIGTERM, SIGHUP, SIGQUIT})
    {
        struct sigaction inherited
        {
        };
        sigaction(signal, nullptr, &inherited);
        // Whoever started this program with nohup wants it to outlive the hang-up.
        if (inherited.sa_handler != SIG_IGN)
        {
            sigaction(signal, &action, nullptr);
        }
    }
}

bool IsRequested()
{
    return sRequested.load();
}

} // namespace zebhost::interrupt
