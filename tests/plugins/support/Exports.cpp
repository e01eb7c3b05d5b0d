// What a test reaches in a fixture's binary.
#include "examples/effects/support/Vst3.h"
#include "tests/plugins/support/HostAccess.h"
#include "tests/plugins/support/Knobs.h"
#include "tests/plugins/support/Recorder.h"

extern "C"
{
    SMTG_EXPORT_SYMBOL int ZebFixtureSet(const char* name, double value)
    {
        const auto knob = fixture::KnobCalled(name);
        if (knob)
            fixture::Set(*knob, value);
        return knob ? 1 : 0;
    }

    SMTG_EXPORT_SYMBOL double ZebFixtureGet(const char* name)
    {
        const auto knob = fixture::KnobCalled(name);
        return knob ? fixture::Get(*knob) : 0.0;
    }

    SMTG_EXPORT_SYMBOL void ZebFixtureReset()
    {
        fixture::ResetKnobs();
    }

    SMTG_EXPORT_SYMBOL const char* ZebFixtureDo(const char* command)
    {
        static std::string sAnswer;
        sAnswer = fixture::CarryOut(command);
        return sAnswer.c_str();
    }
}
