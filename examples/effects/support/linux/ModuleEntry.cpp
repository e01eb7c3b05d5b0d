// Called right after the binary was loaded and right before it is unloaded, with the handle that dlopen gave.
#include "examples/effects/support/Vst3.h"

extern "C"
{
    SMTG_EXPORT_SYMBOL bool ModuleEntry(void*)
    {
        return true;
    }

    SMTG_EXPORT_SYMBOL bool ModuleExit()
    {
        return true;
    }
}
