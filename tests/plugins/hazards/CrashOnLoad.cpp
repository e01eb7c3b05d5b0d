// Crashes while it is being loaded, before any of its functions is called.
#include "tests/plugins/support/Behaviour.h"

#include <csignal>

namespace
{

[[maybe_unused]] const int sCrash = raise(SIGSEGV);

} // namespace

void fixture::Vary(Behaviour&)
{
}
