// The entry points by their names on macOS, which a host falls back on elsewhere.
#include "tests/plugins/support/Recorder.h"

#include "examples/effects/support/Vst3.h"

extern "C"
{
    SMTG_EXPORT_SYMBOL bool bundleEntry(void* handle)
    {
        fixture::Record("module.bundleEntry", handle != nullptr ? 1 : 0);
        return true;
    }

    SMTG_EXPORT_SYMBOL bool bundleExit()
    {
        fixture::Record("module.bundleExit");
        return true;
    }
}
