#pragma once

#include "host/src/VST/interface/VST2Interface.h"
#include "tests/plugins/vst2/support/Knobs.h"

#include <optional>
#include <string>
#include <vector>

namespace vst2fixture
{

using namespace zebaudiofilterhost::vst;

// Given by the build.
extern const char* const kFixtureName;

struct Properties
{
    std::int32_t flags;
    std::int32_t minimum = 0;
    std::int32_t maximum = 0;
    std::int32_t step = 0;
};

struct Parameter
{
    std::string name;
    std::string label;
    float initial = 0.0F;
    bool canBeAutomated = true;
    std::optional<Properties> properties{}; // none: effGetParameterProperties does not answer
};

struct Member
{
    std::string name;
    bool isSynth = false;
};

// What a fixture is. It behaves unless its own file says otherwise, by changing one thing or two in Vary.
struct Behaviour
{
    std::string name = kFixtureName;
    std::string vendor = "Zeb Fixtures";
    std::string product = "Zeb Fixture Set";
    std::vector<Parameter> parameters{
        {"Amount", "%"}, {"Ramp", "dB", 0.5F, true, Properties{kVstParameterCanRamp}}, {"Locked", "", 1.0F, false}};
    std::vector<std::string> programs{"Program 1", "Program 2", "Program 3"};
    bool hasDisplay = true; // of parameters: effGetParamDisplay gives a text
    bool isShell = false;
    std::vector<Member> members; // of a shell

    // What does harm, and where; null: nothing.
    void (*atEntry)() = nullptr;
    void (*atOpen)() = nullptr;
    void (*atProcess)() = nullptr;
    void (*atNextMember)() = nullptr; // a shell that never comes to its end

    KnobValues knobs = HarmlessKnobs();
    double& operator[](Knob knob) { return knobs[static_cast<std::size_t>(knob)]; }
};

// Written by each fixture.
void Vary(Behaviour& behaviour);

const Behaviour& TheBehaviour();

inline void Happen(void (*harm)())
{
    if (harm != nullptr)
        harm();
}

} // namespace vst2fixture
