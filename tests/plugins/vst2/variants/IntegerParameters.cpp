// Parameters with integer ranges, steps and switches.
#include "tests/plugins/vst2/support/Behaviour.h"

void vst2fixture::Vary(Behaviour& behaviour)
{
    constexpr std::int32_t kRange = kVstParameterUsesIntegerMinMax;
    constexpr std::int32_t kStep = kVstParameterUsesIntStep;
    const auto add = [&](const char* name, const Properties& properties)
    {
        behaviour.parameters.push_back({name, "", 0.5F, true, properties});
    };
    behaviour.parameters.clear();
    add("0..10", {kRange, 0, 10});
    add("5..5", {kRange, 5, 5});
    add("-20..20", {kRange, -20, 20});
    add("10..0", {kRange, 10, 0});
    add("Everything", {kRange, -2147483647 - 1, 2147483647});
    add("Step 4", {kStep, 0, 0, 4});
    add("Switch", {kVstParameterIsSwitch});
    add("Switch 3", {kStep | kVstParameterIsSwitch, 0, 0, 3});
    add("No flags", {0, 0, 10, 3});
}
