#include "tests/plugins/units/RecorderKnobs.h"

#include <cstdlib>
#include <map>
#include <string>

namespace fixture
{

namespace
{

double* Find(const char* name)
{
    static const std::map<std::string, double RecorderKnobs::*> sNames = {
        {"inputMemory", &RecorderKnobs::inputMemory},
        {"renderResult", &RecorderKnobs::renderResult},
        {"refusesFormats", &RecorderKnobs::refusesFormats}};
    const auto found = sNames.find(name);
    return found == sNames.end() ? nullptr : &(Knobs().*found->second);
}

// A program that loads the bundle for a test of its own sets a variable.
RecorderKnobs AtFirst()
{
    RecorderKnobs knobs;
    if (const char* result = std::getenv("ZEB_FIXTURE_RENDER_RESULT"))
        knobs.renderResult = std::atoi(result);
    return knobs;
}

} // namespace

RecorderKnobs& Knobs()
{
    static RecorderKnobs sKnobs = AtFirst();
    return sKnobs;
}

} // namespace fixture

#define ZEB_EXPORTED extern "C" __attribute__((visibility("default")))

ZEB_EXPORTED int ZebFixtureSet(const char* name, double value)
{
    double* const knob = fixture::Find(name);
    if (knob)
        *knob = value;
    return knob ? 1 : 0;
}

ZEB_EXPORTED double ZebFixtureGet(const char* name)
{
    const double* const knob = fixture::Find(name);
    return knob ? *knob : 0.0;
}

ZEB_EXPORTED void ZebFixtureReset()
{
    fixture::Knobs() = {};
}
