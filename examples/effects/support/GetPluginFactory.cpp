// The one entry point that every system shares.
#include "examples/effects/support/PluginFactory.h"

extern "C" SMTG_EXPORT_SYMBOL Steinberg::IPluginFactory* PLUGIN_API GetPluginFactory()
{
    static effects::PluginFactory sFactory(effects::DescribePlugin());
    return &sFactory;
}
