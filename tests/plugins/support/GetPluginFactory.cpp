#include "tests/plugins/support/Behaviour.h"
#include "tests/plugins/support/FixtureFactory.h"
#include "tests/plugins/support/Recorder.h"

extern "C" SMTG_EXPORT_SYMBOL Steinberg::IPluginFactory* PLUGIN_API GetPluginFactory()
{
    fixture::Record("module.GetPluginFactory");
    fixture::Happen(fixture::TheBehaviour().atGetPluginFactory);
    static fixture::FixtureFactory sFactory;
    return fixture::IsOn(fixture::Knob::kFactoryIsNull) ? nullptr : &sFactory;
}
