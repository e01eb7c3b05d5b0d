#pragma once

#include "examples/effects/support/Vst3.h"

#include <string>

namespace fixture
{

using namespace Steinberg;
using namespace Steinberg::Vst;

class FixtureView;
class RunLoopUser;

// The ways to the host that this bundle's newest objects have got, for calls that a test asks for and for those from
// within process and from threads. Null when there is none. Any thread.
IComponentHandler* Handler();
void SetHandler(IComponentHandler* handler);
FUnknown* HostContext();
void SetHostContext(FUnknown* context);
FixtureView* NewestView();
void SetNewestView(FixtureView* view);
RunLoopUser* NewestRunLoopUser();
void SetNewestRunLoopUser(RunLoopUser* user);

// Carries out a command of a test: see README.md. The answer is text, "none" when there is nobody to ask, "unknown"
// for a command that there isn't.
std::string CarryOut(const std::string& command);

} // namespace fixture
