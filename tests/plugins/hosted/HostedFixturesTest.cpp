// Each fixture through the whole library: what it ends in, and that nothing of it stays behind.
#include "foundation/zebcore/MainThreadLoop.h"
#include "foundation/zebcore/PropList.h"
#include "module/Module.h"
#include "tests/plugins/FixturePaths.h"
#include "tests/plugins/FixtureRecorder.h"
#include "tests/plugins/hosted/HostedPlugin.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <ostream>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

// What becomes of a bundle: how many filters the catalogue gets, and how the first of them presents itself.
struct Expected
{
    const char* bundle;
    bool loads = true;
    std::size_t filters = 1;
    int parameters = 2;
    int inputs = 2;
    int outputs = 2;
    int presets = 5;
    bool editor = true;
    float level = 0.5F; // of the first output channel, for 0.5 at the input
};

std::ostream& operator<<(std::ostream& stream, const Expected& expected)
{
    return stream << expected.bundle;
}

constexpr Expected Nothing(const char* bundle)
{
    return {.bundle = bundle, .filters = 0};
}

constexpr Expected Unloadable(const char* bundle)
{
    return {.bundle = bundle, .loads = false, .filters = 0};
}

constexpr Expected WithoutController(const char* bundle)
{
    return {.bundle = bundle, .parameters = 0, .presets = 0, .editor = false};
}

constexpr Expected kExpected[] = {
    {.bundle = "Normal"},
    Nothing("NullFactory"),
    Nothing("NoFactory"),
    {.bundle = "EntryRefuses"},
    {.bundle = "NoEntry"},
    {.bundle = "ForeignEntryNames"},
    {.bundle = "FactoryInfoFails"},
    Nothing("NoClasses"),
    Nothing("ControllerOnly"),
    Nothing("NegativeClassCount"),
    {.bundle = "HugeClassCount"},
    {.bundle = "ClassInfoFails"},
    {.bundle = "NamesOnly"},
    {.bundle = "EightBitNames"},
    {.bundle = "EmptyName"},
    {.bundle = "FullNames"},
    {.bundle = "TwoEffects", .filters = 2},
    Nothing("InstrumentOnly"),
    Nothing("ComponentMissing"),
    Nothing("ComponentNull"),
    Nothing("InitializeFails"),
    Nothing("NoProcessor"),
    Nothing("ControllerFails"),
    WithoutController("NoController"),
    WithoutController("ControllerIDZero"),
    WithoutController("ControllerMissing"),
    {.bundle = "SingleComponent"},
    {.bundle = "NotConnectable", .presets = 0},
    {.bundle = "VendorSpecific"},
    {.bundle = "ProcessFails"},
    {.bundle = "ProcessThrows", .level = 9.0F},
    {.bundle = "RestartInProcess"},
    {.bundle = "RestartFromThread"},
    {.bundle = "EditsFromThread"},
    {.bundle = "EditsInProcess"},
    {.bundle = "WritesParameters"},
    {.bundle = "LatencyNegative"},
    {.bundle = "LatencyHuge"},
    {.bundle = "LatencyLiar"},
    {.bundle = "TailInfinite"},
    {.bundle = "MultiBus", .inputs = 4, .outputs = 4},
    {.bundle = "SideChain", .inputs = 4},
    {.bundle = "EventBuses"},
    {.bundle = "OddArrangements", .inputs = 7, .outputs = 11},
    {.bundle = "ArrangementFails"},
    {.bundle = "BusInfoFails"},
    {.bundle = "RefusesArrangements"},
    {.bundle = "HugeCounts", .presets = 32768},
    {.bundle = "NegativeCounts", .parameters = 0, .inputs = 0, .outputs = 0, .presets = 0},
    {.bundle = "ParameterInfoFails", .parameters = 5},
    {.bundle = "ManyParameters", .parameters = 3000},
    {.bundle = "ProgramLists"},
    {.bundle = "NoRootPrograms", .presets = 0},
    {.bundle = "StateRefused"},
    {.bundle = "StateFails"},
    {.bundle = "StateEmpty"},
    {.bundle = "StateLarge"},
    {.bundle = "NoView", .editor = false},
    {.bundle = "ViewUnsupported", .editor = false},
    {.bundle = "ViewSecondBest", .editor = false},
    {.bundle = "AttachFails"},
    {.bundle = "ResizesInAttached"},
    {.bundle = "RunLoopUser"},
    {.bundle = "RunLoopQuitter"},
    Unloadable("WindowsOnly"),
    Unloadable("OtherArchitecture"),
    Unloadable("NotABinary"),
    Unloadable("ForeignBinary"),
    Unloadable("EmptyBundle"),
    Unloadable("PlainFile"),
};

class HostedFixture : public testing::TestWithParam<Expected>
{
protected:
    static void SetUpTestSuite() { Initialize(); }
    static void TearDownTestSuite() { Terminate(); }
};

// Saves, changes nothing, loads.
void ExpectThatPresetsTravel(AudioFilter& filter)
{
    PropList list;
    PresetData preset(list);
    filter.SaveSettings(preset);
    EXPECT_NO_THROW(filter.LoadSettings(preset));
}

void ExpectThatTheEditorOpens(AudioFilter& filter)
{
    const auto editor = filter.CreateCustomEditor();
    ASSERT_NE(editor, nullptr);
    editor->Open(nullptr);
    editor->GetEditorRect();
    editor->Close();
}

TEST_P(HostedFixture, EndsAsItShould)
{
    const Expected& expected = GetParam();
    EXPECT_EQ(Scan(FixtureBundle(expected.bundle)).size(), expected.filters);
    const FilterPtr filter = MakeFilter(FixtureBundle(expected.bundle));
    ASSERT_EQ(filter != nullptr, expected.filters > 0);
    if (!filter)
        return;
    EXPECT_EQ(filter->GetParameterCount(), expected.parameters);
    EXPECT_EQ(filter->GetNumberOfInputChannels(), expected.inputs);
    EXPECT_EQ(filter->GetNumberOfOutputChannels(), expected.outputs);
    EXPECT_EQ(filter->GetNumFactoryPresets(), expected.presets);
    ASSERT_EQ(filter->HasCustomEditor(), expected.editor);
    if (expected.editor)
        ExpectThatTheEditorOpens(*filter);
    ExpectThatPresetsTravel(*filter);
    const auto out = RunBlocks(*filter, 5, 700);
    if (expected.outputs > 0)
    {
        EXPECT_EQ(out.front().back(), expected.level);
    }
}

// Reads what a fixture leaves behind once its filters are gone.
TEST_P(HostedFixture, LeavesNothingBehind)
{
    FilterPtr filter = MakeFilter(FixtureBundle(GetParam().bundle));
    if (filter)
        RunBlocks(*filter, 2, 256);
    filter.reset();
    zebcore::threads::PumpMainThread();
    if (GetParam().loads)
    {
        EXPECT_EQ(RecorderOf(FixtureBundle(GetParam().bundle)).LiveObjects(), 0);
    }
}

INSTANTIATE_TEST_SUITE_P(Bundles, HostedFixture, testing::ValuesIn(kExpected),
                         [](const auto& test) { return std::string(test.param.bundle); });

// A fixture that is in nobody's table is tested by nobody.
TEST(HostedFixtures, AreAllInTheTable)
{
    for (const auto& entry : std::filesystem::directory_iterator(FixtureFolder()))
    {
        const std::string name = entry.path().stem().string();
        const auto is = [&](const Expected& expected)
        {
            return name == expected.bundle;
        };
        const bool known = std::any_of(std::begin(kExpected), std::end(kExpected), is);
        EXPECT_TRUE(known || entry.path().extension() != ".vst3") << name;
    }
}

} // namespace
