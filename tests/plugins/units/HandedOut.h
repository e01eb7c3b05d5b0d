#pragma once

#include <AudioToolbox/AudioToolbox.h>

namespace fixture
{

// Notes that the host gets a reference on the object, or has lent one to the unit. Keeps references of its own, so
// that one that is released too often is counted, and harmless. The second time for one object it notes nothing.
// Gives the object back.
CFTypeRef HandOut(const char* kind, CFTypeRef object);

// Of each: its kind, and how often it has been released since, such as "name 1"; one a line, in the order of handing
// out. Valid until the next call.
const char* Releases();

} // namespace fixture
