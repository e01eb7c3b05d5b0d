// Which thread is the main thread.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/Threads.h"

namespace zebaudiofilterhost
{

/// Makes the calling thread the main thread. The first Initialize does this. [main]
ZEB_EXPORT void InitializeMainThreadID();

/// Identifier of the main thread, 0 before the first Initialize. [any]
ZEB_EXPORT zebcore::threads::ThreadID GetMainThreadID();

/// Whether the caller runs on the main thread; false on every thread before the first Initialize. [any]
ZEB_EXPORT bool CurrentThreadIDIsMainThreadID();

} // namespace zebaudiofilterhost
