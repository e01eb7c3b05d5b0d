#include "Interrupt.h"

#include <atomic>
#include <csignal>

namespace soak::interrupt
{

namespace
{

std::atomic<bool> sRequested{false};

void OnSignal(int)
{
    sRequested.store(true);
}

} // namespace

void Watch()
{
    struct sigaction action
    {
    };
    action.sa_handler = OnSignal;
    action.sa_flags = static_cast<int>(SA_RESETHAND); // the second ends the process at once
    sigemptyset(&action.sa_mask);
    sigaction(SIGINT, &action, nullptr);
    sigaction(SIGTERM, &action, nullptr);
}

bool IsRequested()
{
    return sRequested.load();
}

} // namespace soak::interrupt
