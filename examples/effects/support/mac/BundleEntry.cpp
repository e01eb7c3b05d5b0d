// Called right after the bundle was loaded and right before it is unloaded, with the CFBundleRef.
#include "examples/effects/support/Vst3.h"

extern "C"
{
    SMTG_EXPORT_SYMBOL bool bundleEntry(void*)
    {
        return true;
    }

    SMTG_EXPORT_SYMBOL bool bundleExit()
    {
        return true;
    }
}
