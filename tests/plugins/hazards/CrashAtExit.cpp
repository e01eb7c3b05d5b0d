// Behaves until the process ends, and then crashes.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>

namespace
{

struct Crash
{
    ~Crash() { raise(SIGSEGV); }
};

const Crash sCrash;

} // namespace

void fixture::Vary(Behaviour&)
{
}
