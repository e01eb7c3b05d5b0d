// Each VST 2 fixture through the whole library: what it ends in, and that nothing of it stays behind.
#include "foundation/zebcore/NativePath.h"
#include "foundation/zebcore/PropList.h"
#include "foundation/zebcore/StringConversion.h"
#include "host/BannedPluginManager.h"
#include "host/PluginModuleInfoManager.h"
#include "tests/plugins/vst2/FixtureID.h"
#include "tests/plugins/vst2hosted/HostedVST2.h"

#include <algorithm>
#include <fstream>
#include <gtest/gtest.h>
#include <ostream>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

// What becomes of a binary: how many filters the catalogue gets, and how the first of them presents itself.
struct Expected
{
    const char* name;
    bool known = true; // leaves a record, with filters or without
    std::size_t filters = 1;
    int parameters = 3;
    int inputs = 2;
    int outputs = 2;
    int presets = 3;
    bool editor = true;
    float level = 0.5F; // of the last frame of the first output, after five blocks of 0.5 on buffers that held 9
    bool isFixture = true;
};

std::ostream& operator<<(std::ostream& stream, const Expected& expected)
{
    return stream << expected.name;
}

constexpr Expected Rejected(const char* name)
{
    return {.name = name, .known = false, .filters = 0};
}

constexpr Expected WithoutFilters(const char* name)
{
    return {.name = name, .filters = 0};
}

constexpr Expected kExpected[] = {
    {.name = "Normal"},
    Rejected("Version2299"),
    {.name = "Version2300"},
    Rejected("NullEntry"),
    Rejected("WrongMagic"),
    {.name = "Helper", .known = false, .filters = 0, .isFixture = false},
    {.name = "OldMain"},
    {.name = "BothEntries"},
    {.name = "MachoEntry"},
    {.name = "Bundled"},
    {.name = "Flat"},
    {.name = "Suffixed"},
    WithoutFilters("Synth"),
    {.name = "ListedEffect"},
    WithoutFilters("ListedSynth"),
    {.name = "EmptyName"},
    {.name = "Shell", .filters = 3},
    {.name = "MixedShell", .filters = 2},
    WithoutFilters("EmptyShell"),
    {.name = "OddCategory"},
    {.name = "Generator"},
    {.name = "Mono", .inputs = 1, .outputs = 1},
    {.name = "CanMono"},
    {.name = "RefusesArrangements"},
    {.name = "NoArrangement"},
    {.name = "NullArrangements"},
    {.name = "HalfArrangement"},
    {.name = "HugeArrangement"},
    {.name = "NegativeArrangement"},
    {.name = "EmptyArrangement"},
    {.name = "OtherArrangement"},
    {.name = "StubbornPins"},
    {.name = "Surround", .inputs = 6, .outputs = 6},
    {.name = "FourOutputs", .outputs = 4},
    {.name = "SideChain", .inputs = 4},
    {.name = "NoInputs", .inputs = 0, .level = 0.0F},
    {.name = "NoPins", .inputs = 0, .outputs = 0},
    {.name = "ManyPins", .inputs = 200, .outputs = 200},
    {.name = "Accumulates", .level = 11.5F},
    {.name = "ThrowsInProcess", .level = 9.0F},
    {.name = "ThrowsAnything", .level = 9.0F},
    {.name = "ThrowsInDispatcher"},
    {.name = "ThrowsInClose"},
    {.name = "AsksForTime"},
    {.name = "Latency"},
    {.name = "NegativeLatency"},
    {.name = "CallsInEntry"},
    {.name = "CallsInOpen"},
    {.name = "CallsInClose"},
    {.name = "CallsWithoutEffect"},
    {.name = "CallsFromThread"},
    {.name = "IntegerParameters", .parameters = 9},
    {.name = "NoParameters", .parameters = 0, .presets = 0},
    {.name = "ManyParameters", .parameters = 3000},
    {.name = "NoDisplays"},
    {.name = "HugeCounts", .parameters = 20000, .presets = 20000},
    {.name = "NegativeCounts", .parameters = 0, .inputs = 0, .outputs = 0, .presets = 0},
    {.name = "FullTexts"},
    {.name = "IllFormedTexts"},
    {.name = "EmptyProgramName"},
    {.name = "Chunks"},
    {.name = "ChunkRefused"},
    {.name = "ChunkEmpty"},
    {.name = "ChunkNull"},
    {.name = "ChunkNegative"},
    {.name = "ChunkLarge"},
    {.name = "NoEditor", .editor = false},
    {.name = "NullRect"},
    {.name = "OddRect"},
    {.name = "SizesInOpen"},
    {.name = "EditorRefuses"},
};

// Throw where nothing is guarded, so that they have no end that this table could tell: the one in its scan, the other
// whenever a value is set or asked for.
constexpr const char* kThrowsInScan = "ThrowsInVersion";
constexpr const char* kThrowsInUse = "ThrowsInParameters";

PluginLocator LocatorOf(const std::filesystem::path& path)
{
    return {kTechnologyVST, zebcore::filesupport::FromNativePath(path.string())};
}

bool IsKnown(const std::filesystem::path& path)
{
    return PluginModuleInfoManager::GetInstance().FindPluginInfo(LocatorOf(path)) != nullptr;
}

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

class HostedVST2Fixture : public HostedVST2, public testing::WithParamInterface<Expected>
{
};

TEST_P(HostedVST2Fixture, EndsAsItShould)
{
    const Expected& expected = GetParam();
    const auto path = VST2Fixture(expected.name);
    EXPECT_EQ(Scan(path).size(), expected.filters);
    EXPECT_EQ(IsKnown(path), expected.known);
    const FilterPtr filter = MakeFilter(path);
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
    else
        EXPECT_EQ(filter->CreateCustomEditor(), nullptr);
    ExpectThatPresetsTravel(*filter);
    const auto out = RunBlocks(*filter, 5, 700);
    if (expected.outputs > 0)
    {
        EXPECT_EQ(out.front().back(), expected.level);
    }
}

// An instance whose magic is wrong is nobody's to close: it is no VST 2 plug-in.
TEST_P(HostedVST2Fixture, LeavesNothingBehind)
{
    if (!GetParam().isFixture || std::string_view(GetParam().name) == "WrongMagic")
        return;
    const auto path = VST2Fixture(GetParam().name);
    FilterPtr filter = MakeFilter(path);
    if (filter)
        RunBlocks(*filter, 2, 256);
    filter.reset();
    EXPECT_EQ(RecorderOf(path).LiveObjects(), 0);
}

INSTANTIATE_TEST_SUITE_P(Binaries, HostedVST2Fixture, testing::ValuesIn(kExpected),
                         [](const auto& test) { return std::string(test.param.name); });

// A fixture that is in nobody's table is tested by nobody.
TEST(HostedVST2Fixtures, AreAllInTheTable)
{
    for (const auto& entry : std::filesystem::directory_iterator(VST2FixtureFolder()))
    {
        const std::string name = entry.path().stem().string();
        const bool isPlugin = entry.path().extension() == ".so" || entry.path().extension() == ".vst";
        const bool known = std::any_of(std::begin(kExpected), std::end(kExpected),
                                       [&](const Expected& expected) { return name == expected.name; });
        EXPECT_TRUE(known || !isPlugin || name == kThrowsInScan || name == kThrowsInUse) << name;
    }
}

std::vector<std::string> NamesIn(const char* fixture)
{
    std::vector<std::string> names;
    for (const DescriptorPtr& descriptor : Scan(VST2Fixture(fixture)))
        names.push_back(zebcore::utility::NarrowFromUTF16(descriptor->GetName()));
    return names;
}

// What a scan throws comes out of it, with the instance closed behind it.
TEST_F(HostedVST2, WhatAScanAsksUnguardedEndsItByWhatIsThrown)
{
    const auto path = VST2Fixture(kThrowsInScan);
    EXPECT_THROW(Scan(path), std::runtime_error);
    EXPECT_FALSE(IsKnown(path));
    EXPECT_EQ(RecorderOf(path).LiveObjects(), 0);
}

TEST_F(HostedVST2, WhatASetterThrowsPassesThroughAndTheFilterCanGo)
{
    const auto path = VST2Fixture(kThrowsInUse);
    const auto descriptors = Scan(path);
    ASSERT_EQ(descriptors.size(), 1U);
    auto filter = utility::CreateAudioFilter(descriptors.front()->GetUniqueID());
    ASSERT_TRUE(filter);
    EXPECT_THROW(filter->SetParameter(0, 0.5F), std::runtime_error);
    EXPECT_THROW(filter->GetParameter(0), std::runtime_error);
    filter.reset();
    EXPECT_EQ(RecorderOf(path).LiveObjects(), 0);
}

TEST_F(HostedVST2, EffectsAreNamedAfterTheirFilesAndMembersByThemselves)
{
    EXPECT_EQ(NamesIn("Normal"), std::vector<std::string>{"Normal"});
    EXPECT_EQ(NamesIn("IllFormedTexts"), std::vector<std::string>{"IllFormedTexts"});
    EXPECT_EQ(NamesIn("Shell"), (std::vector<std::string>{"First Member", "Second Member", "Third Member"}));
    EXPECT_EQ(NamesIn("MixedShell"), (std::vector<std::string>{"Left Effect", "Right Effect"}));
}

TEST_F(HostedVST2, EachMemberIsMadeByItsOwnID)
{
    const auto members = Scan(VST2Fixture("Shell"));
    ASSERT_EQ(members.size(), 3U);
    const FixtureRecorder recorder = RecorderOf(VST2Fixture("Shell"));
    for (std::uint32_t i = 0; i < 3; ++i)
    {
        const std::string number = std::to_string(VST2FixtureID("Shell") + i);
        const UTF16String id = members[i]->GetUniqueID();
        EXPECT_EQ(zebcore::utility::NarrowFromUTF16(id), "2:" + number + " Shell");
        recorder.Clear();
        const FilterPtr filter = zebaudiofilterhost::utility::CreateAudioFilter(id);
        ASSERT_NE(filter, nullptr);
        EXPECT_EQ(filter->GetDisplayName(), members[i]->GetName());
        EXPECT_EQ(recorder.CallsTo("entry."), std::vector<std::string>{"entry.audioMasterCurrentId -> " + number});
    }
}

// A listed instrument still counts as known, so that it is not scanned over and over.
TEST_F(HostedVST2, ThePermanentListKeepsEffectsOut)
{
    const auto file = std::filesystem::temp_directory_path() / "vst2-hosted-permanent-list.xml";
    std::ofstream(file) << "<pluginlist><plugin filename=\"ListedEffect.so\" uniqueid=\""
                        << VST2FixtureID("ListedEffect")
                        << "\" version=\"2400\"/><plugin filename=\"ListedSynth.so\"/></pluginlist>";
    zebcore::filesupport::File list(zebcore::filesupport::FromNativePath(file.string()));
    ASSERT_TRUE(BannedPluginManager::GetInstance().LoadStaticConfiguration(list));
    for (const auto& [name, known] : {std::pair{"ListedEffect", false}, std::pair{"ListedSynth", true}})
    {
        PluginModuleInfoManager::GetInstance().RemovePluginLocators({LocatorOf(VST2Fixture(name))});
        EXPECT_TRUE(Scan(VST2Fixture(name)).empty()) << name;
        EXPECT_EQ(IsKnown(VST2Fixture(name)), known) << name;
    }
    std::ofstream(file) << "<pluginlist></pluginlist>";
    EXPECT_TRUE(BannedPluginManager::GetInstance().LoadStaticConfiguration(list));
    std::filesystem::remove(file);
}

} // namespace
