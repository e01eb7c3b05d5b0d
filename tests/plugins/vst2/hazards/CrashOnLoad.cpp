// Crashes while it is being loaded, before any of its functions is called.
#include "tests/plugins/vst2/support/Behaviour.h"

#include <csignal>

namespace
{

[[maybe_unused]] const int sCrash = raise(SIGSEGV);

} // namespace

void vst2fixture::Vary(Behaviour&)
{
}
