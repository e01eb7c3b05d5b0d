#pragma once

#include "examples/effects/support/BusSet.h"
#include "examples/effects/support/ParameterSet.h"
#include "examples/effects/support/PluginFactory.h"
#include "tests/plugins/support/Knobs.h"

#include <string>
#include <vector>

namespace fixture
{

using namespace effects;

// Parameters that every fixture has unless it says otherwise: one of each sort, with IDs that are no indices.
constexpr ParamID kAmount = 7;
constexpr ParamID kMeter = 8; // read-only
constexpr ParamID kBypass = 9;
constexpr ParamID kProgram = 10; // program change, in the root unit
constexpr ParamID kUnautomated = 11;

enum class ClassKind
{
    kEffect,          // with a controller class of its own
    kSingleComponent, // component and controller in one
    kInstrument,
    kControllerOnly // a controller class that no effect asks for
};

struct ClassShape
{
    ClassKind kind = ClassKind::kEffect;
    std::u16string name = {}; // empty: the bundle's
    std::string subCategories = "Fx";
};

struct UnitShape
{
    UnitID id;
    ProgramListID programList;
};

struct ProgramListShape
{
    ProgramListID id;
    std::u16string prefix; // a program is called by this and its number, from 1
    int32 count;
};

// What a bundle is built as. Each variant changes what it is about.
struct Behaviour
{
    std::u16string vendor = u"Zeb Fixtures";
    FactoryLevel level = FactoryLevel::kUnicode;
    std::u16string classVendor; // of the classes, empty: as above
    std::vector<ClassShape> classes{{}};

    std::vector<Bus> inputs{{u"In", SpeakerArr::kStereo}};
    std::vector<Bus> outputs{{u"Out", SpeakerArr::kStereo}};
    std::vector<Parameter> parameters = CommonParameters();
    std::vector<UnitShape> units{{kRootUnitId, 21}};
    std::vector<ProgramListShape> programLists{{21, u"Program ", 5}};

    std::vector<FUID> hiddenInterfaces = VendorInterfaces(); // that no object answers for
    std::string displayName;                                 // by the vendor-specific interface
    bool hasView = true;
    std::vector<std::string> viewTypes{kPlatformTypeX11EmbedWindowID, kPlatformTypeNSView};
    bool usesRunLoop = false;

    // What does harm, and where; null: nothing.
    void (*atEntry)() = nullptr;
    void (*atGetPluginFactory)() = nullptr;
    void (*atCreate)() = nullptr;
    void (*atInitialize)() = nullptr;

    KnobValues knobs = HarmlessKnobs();
    double& operator[](Knob knob) { return knobs[static_cast<std::size_t>(knob)]; }

    static std::vector<Parameter> CommonParameters();
    static std::vector<FUID> VendorInterfaces();
};

// Written by each bundle.
void Vary(Behaviour& behaviour);

const Behaviour& TheBehaviour();

inline void Happen(void (*harm)())
{
    if (harm != nullptr)
        harm();
}

// Given by the build.
extern const char* const kBundleName;

// Class IDs, which hold a hash of the bundle's name: index is the class's place in Behaviour::classes.
FUID ComponentID(std::size_t index);
FUID ControllerID(std::size_t index);

} // namespace fixture
