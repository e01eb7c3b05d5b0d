#include "tests/plugins/support/Behaviour.h"
#include "tests/plugins/support/Recorder.h"

extern "C"
{
    SMTG_EXPORT_SYMBOL bool ModuleEntry(void* handle)
    {
        fixture::Record("module.ModuleEntry", handle != nullptr ? 1 : 0);
        fixture::Happen(fixture::TheBehaviour().atEntry);
        return fixture::IsOn(fixture::Knob::kEntryResult);
    }

    SMTG_EXPORT_SYMBOL bool ModuleExit()
    {
        fixture::Record("module.ModuleExit");
        return true;
    }
}
