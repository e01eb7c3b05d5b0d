// Programs and chunks of a VST 2 plug-in as presets, and the text of a parameter.

#include "host/src/VST/src/VSTAudioFilter.h"
#include "tests/vst/support/FakeEffect.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <climits>
#include <cstring>
#include <locale>
#include <string>

namespace zebaudiofilterhost::vst
{

namespace
{

using fakeeffect::FakeEffect;
using testing::ElementsAre;

using Bytes = std::vector<unsigned char>;

// A plug-in with programs, which hold its one parameter or a chunk of one byte.
class Presets : public testing::Test
{
protected:
    void Make(const std::vector<std::string>& names, int flags = effFlagsCanReplacing)
    {
        filter.reset();
        programs = Bytes(names.size());
        fake.effect.numPrograms = static_cast<int>(names.size());
        fake.effect.flags = flags;
        fake.On(effGetProgramNameIndexed,
                [names](int index, long long, void* ptr, float)
                {
                    std::strcpy(static_cast<char*>(ptr), names.at(static_cast<std::size_t>(index)).c_str());
                    return 1LL;
                });
        fake.On(effSetProgram,
                [this](int, long long value, void*, float)
                {
                    current = static_cast<std::size_t>(value);
                    return 0LL;
                });
        fake.On(effGetChunk,
                [this](int, long long, void* ptr, float)
                {
                    *static_cast<void**>(ptr) = &programs.at(current);
                    return 1LL;
                });
        fake.On(effSetChunk,
                [this](int, long long value, void* ptr, float)
                {
                    const auto* bytes = static_cast<const unsigned char*>(ptr);
                    loaded.assign(bytes, bytes + value);
                    programs.at(current) = *bytes;
                    return 0LL;
                });
        filter = new VSTAudioFilter(u"2:1 Fake", u"/fake.so", fake.Get(), true, true);
        fake.ClearCalls();
    }

    FakeEffect fake;
    Bytes programs;
    Bytes loaded; // by the last effSetChunk
    std::size_t current = 0;
    boost::intrusive_ptr<VSTAudioFilter> filter;
    PropList propList;
};

constexpr int kChunks = effFlagsCanReplacing | effFlagsProgramChunks;

} // namespace

TEST_F(Presets, NamesAreThePluginsPrograms)
{
    Make({"Init", "", "Caf\xc3\xa9", "\xff!"});
    EXPECT_EQ(filter->GetNumFactoryPresets(), 4);
    EXPECT_TRUE(filter->GetFactoryPresetName(0) == u"Init");
    EXPECT_TRUE(filter->GetFactoryPresetName(1).empty());
    EXPECT_TRUE(filter->GetFactoryPresetName(2) == u"Caf\u00e9");
    EXPECT_TRUE(filter->GetFactoryPresetName(3) == u"\ufffd!");
    EXPECT_EQ(fake.CallsTo("effGetProgramNameIndexed").at(2).value, 0);
    fake.ClearCalls();
    for (const int index : {-1, 4, INT_MIN, INT_MAX})
        EXPECT_TRUE(filter->GetFactoryPresetName(index).empty()) << index;
    EXPECT_TRUE(fake.Calls().empty());
    fake.On(effGetProgramNameIndexed,
            [](int, long long, void* ptr, float)
            {
                std::memset(ptr, 'n', 73); // no terminator
                return 1LL;
            });
    EXPECT_TRUE(filter->GetFactoryPresetName(0) == UTF16String(72, u'n'));
}

TEST_F(Presets, SetFactoryPresetMovesTheProgramsStateToTheFirst)
{
    struct Case
    {
        const char* what;
        int flags;
        std::vector<std::string> calls;
    };
    for (const Case& expected :
         {Case{"chunks", kChunks, {"effSetProgram", "effGetChunk", "effSetProgram", "effSetChunk"}},
          Case{"parameters",
               effFlagsCanReplacing,
               {"effSetProgram", "getParameter", "effSetProgram", "setParameter"}}})
    {
        fake.effect.numParams = 1;
        Make({"A", "B", "C"}, expected.flags);
        programs = {10, 20, 30};
        filter->SetFactoryPreset(2);
        EXPECT_EQ(fake.Names(), expected.calls) << expected.what;
        EXPECT_EQ(fake.CallsTo("effSetProgram").at(0).value, 2);
        EXPECT_EQ(fake.CallsTo("effSetProgram").at(1).value, 0);
    }
    Make({"A", "B", "C"}, kChunks);
    programs = {10, 20, 30};
    filter->SetFactoryPreset(1);
    EXPECT_THAT(programs, ElementsAre(20, 20, 30));
}

TEST_F(Presets, FactoryPresetsOutOfRangeAndTheFirstAreIgnored)
{
    Make({"A", "B"}, kChunks);
    for (const int index : {0, -1, 2, INT_MIN, INT_MAX})
        filter->SetFactoryPreset(index);
    EXPECT_TRUE(fake.Calls().empty());
    fake.effect.numPrograms = -5;
    EXPECT_EQ(filter->GetNumFactoryPresets(), 0);
    filter->SetFactoryPreset(1);
    EXPECT_TRUE(filter->GetFactoryPresetName(0).empty());
    EXPECT_TRUE(fake.Calls().empty());
}

TEST_F(Presets, ALieAboutTheirNumberIsNotWalkedThrough)
{
    Make({"A"});
    fake.recording = false;
    int asked = 0;
    fake.On(effGetProgramNameIndexed,
            [&asked](int, long long, void*, float)
            {
                ++asked;
                return 0LL;
            });
    fake.effect.numPrograms = INT_MAX;
    EXPECT_EQ(filter->GetNumFactoryPresets(), 32768);
    PresetList list(propList);
    filter->GetFactoryDefaultPresets(list);
    EXPECT_EQ(asked, 32768);
}

TEST_F(Presets, DefaultListHoldsTheStateAndReferences)
{
    Make({"Now", "", "Third", "Now"}, kChunks);
    programs = {77, 1, 2, 3};
    PresetList list(propList);
    list.AppendPreset(u"Old");
    filter->GetFactoryDefaultPresets(list);
    std::set<UTF16String> names;
    list.GetPresetNames(names);
    ASSERT_TRUE(names == (std::set<UTF16String>{u"Now", u"Third"}));
    const auto state = list.GetPreset(u"Now");
    Bytes chunk;
    EXPECT_EQ(state->GetPresetType(), PresetData::kPresetType_Chunk);
    EXPECT_TRUE(state->GetChunkData(chunk));
    EXPECT_THAT(chunk, ElementsAre(77));
    const auto reference = list.GetPreset(u"Third");
    EXPECT_EQ(reference->GetPresetType(), PresetData::kPresetType_Factory);
    EXPECT_EQ(reference->GetFactoryIndex(), 2);
    EXPECT_TRUE(reference->GetFactoryPresetName() == u"Third");
    EXPECT_EQ(reference->GetVersion(), filter->GetCurrentPresetVersion());
    EXPECT_EQ(fake.Count("effSetProgram"), 0U);

    EXPECT_TRUE(filter->LoadSettings(*reference)) << "what it refers to can be loaded";
    EXPECT_THAT(programs, ElementsAre(2, 1, 2, 3));
}

TEST_F(Presets, ChunkIsThatOfTheProgram)
{
    Make({"A"}, kChunks);
    programs = {42};
    PresetData preset(propList);
    EXPECT_TRUE(filter->SaveChunkData(preset));
    EXPECT_EQ(fake.CallsTo("effGetChunk").at(0).index, 1);
    EXPECT_EQ(preset.GetPresetType(), PresetData::kPresetType_Chunk);
    EXPECT_EQ(preset.GetVersion(), filter->GetCurrentPresetVersion());

    const Bytes bytes = {9, 0, 255, 13, 10};
    preset.SetChunkData(bytes.data(), bytes.size());
    EXPECT_TRUE(filter->LoadChunkData(preset)) << "whatever the plug-in answers";
    EXPECT_EQ(fake.CallsTo("effSetChunk").at(0).index, 1);
    EXPECT_EQ(fake.CallsTo("effSetChunk").at(0).value, 5);
    EXPECT_EQ(loaded, bytes);
    fake.Throw(effSetChunk);
    EXPECT_TRUE(filter->LoadChunkData(preset));
}

TEST_F(Presets, ChunksThatAreNoneAreEmpty)
{
    Make({"A"}, kChunks);
    struct Case
    {
        const char* what;
        bool memory;
        long long size;
    };
    unsigned char byte = 5;
    for (const Case& expected : {Case{"no memory", false, 100}, Case{"nothing", true, 0}, Case{"negative", true, -7},
                                 Case{"larger than any", true, LLONG_MAX}})
    {
        fake.On(effGetChunk,
                [&](int, long long, void* ptr, float)
                {
                    EXPECT_EQ(*static_cast<void**>(ptr), nullptr);
                    *static_cast<void**>(ptr) = expected.memory ? &byte : nullptr;
                    return expected.size;
                });
        PresetData preset(propList);
        EXPECT_TRUE(filter->SaveChunkData(preset)) << expected.what;
        Bytes chunk;
        EXPECT_FALSE(preset.GetChunkData(chunk)) << expected.what;
        EXPECT_FALSE(filter->LoadChunkData(preset)) << expected.what;
    }
    EXPECT_EQ(fake.Count("effSetChunk"), 0U);
}

TEST_F(Presets, ASizeWithoutMemoryLeavesThePresetsChunk)
{
    Make({"A"}, kChunks);
    const Bytes before = {9, 8};
    for (const long long size : {1LL, 100LL, -7LL, LLONG_MAX})
    {
        fake.Return(effGetChunk, size);
        PresetData preset(propList);
        preset.SetChunkData(before.data(), before.size());
        int changes = 0;
        preset.GetPresetChangedSignal().connect([&changes](const PresetData&) { ++changes; });
        EXPECT_TRUE(filter->SaveChunkData(preset)) << size;
        EXPECT_EQ(changes, 2) << "of the version and the type, for " << size;
        EXPECT_EQ(preset.GetPresetType(), PresetData::kPresetType_Chunk);
        Bytes chunk;
        EXPECT_TRUE(preset.GetChunkData(chunk)) << size;
        EXPECT_EQ(chunk, before) << size;
    }
}

TEST_F(Presets, WithoutChunksParametersAreSaved)
{
    fake.effect.numParams = 2;
    fake.parameters = {0.25F, 0.75F};
    Make({"A"});
    EXPECT_FALSE(filter->DoPresetsUseChunkData());
    PresetData preset(propList);
    EXPECT_FALSE(filter->SaveChunkData(preset));
    EXPECT_FALSE(filter->LoadChunkData(preset));
    EXPECT_TRUE(preset.IsEmpty());
    filter->SaveSettings(preset);
    fake.parameters = {0.0F, 0.0F};
    EXPECT_TRUE(filter->LoadSettings(preset));
    EXPECT_THAT(fake.parameters, ElementsAre(0.25F, 0.75F));
    EXPECT_EQ(fake.Count("effGetChunk") + fake.Count("effSetChunk"), 0U);
}

TEST_F(Presets, ParameterTextIsThePluginsOrTheNumber)
{
    fake.effect.numParams = 1;
    fake.parameters = {0.5F};
    Make({});
    fake.Text(effGetParamDisplay, "-6 \xb5");
    EXPECT_TRUE(filter->GetParameterString(0) == u"-6 \u00b5") << "each byte by itself";
    fake.On(effGetParamDisplay,
            [](int, long long, void* ptr, float)
            {
                std::memset(ptr, 'd', 128); // no terminator
                return 1LL;
            });
    EXPECT_TRUE(filter->GetParameterString(0) == UTF16String(128, u'd'));
    fake.Return(effGetParamDisplay, 1); // and nothing written
    EXPECT_TRUE(filter->GetParameterString(0) == u"0.5");
    struct Comma : std::numpunct<char>
    {
        char do_decimal_point() const override { return ','; }
    };
    const std::locale before = std::locale::global(std::locale(std::locale(), new Comma));
    EXPECT_TRUE(filter->GetParameterString(0) == u"0.5") << "in any locale";
    std::locale::global(before);
    fake.Throw(effGetParamDisplay);
    EXPECT_TRUE(filter->GetParameterString(0) == u"0.5");
}

} // namespace zebaudiofilterhost::vst
