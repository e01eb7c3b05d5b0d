// Parameters, texts, programs and chunks of real binaries.
#include "audiofilter/PresetList.h"
#include "foundation/zebcore/PropListUtils.h"
#include "tests/plugins/vst2hosted/HostedVST2.h"

#include <set>

namespace
{

using namespace zebaudiofilterhost;
using namespace zebtest;

using Lines = std::vector<std::string>;

TEST_F(HostedVST2, IntegerRangesScaleAndCountSteps)
{
    const FilterPtr filter = Make("IntegerParameters");
    struct Row
    {
        const char16_t* name;
        float real;
        float normalized;
        int steps;
    };
    const Row rows[] = {
        {u"0..10", 5.0F, 0.5F, 0},  {u"5..5", 0.25F, 0.25F, 0},     {u"-20..20", 10.0F, 0.75F, 0},
        {u"10..0", 8.0F, 0.2F, 0},  {u"Everything", 0.0F, 0.5F, 0}, {u"Step 4", 0.75F, 0.75F, 4},
        {u"Switch", 1.0F, 1.0F, 1}, {u"Switch 3", 0.5F, 0.5F, 3},   {u"No flags", 0.5F, 0.5F, 0},
    };
    for (int i = 0; i < 9; ++i)
    {
        const auto info = filter->GetParameterInfo(i);
        ASSERT_NE(info, nullptr);
        EXPECT_EQ(info->GetName(), rows[i].name);
        EXPECT_FLOAT_EQ(info->ToNormalized(rows[i].real), rows[i].normalized) << i;
        EXPECT_NEAR(info->FromNormalized(rows[i].normalized), rows[i].real, 1e-6) << i;
        EXPECT_EQ(info->GetStepCount(), rows[i].steps) << i;
    }
}

TEST_F(HostedVST2, ParametersSayWhatThePluginSays)
{
    const FilterPtr filter = Make("Normal");
    const auto amount = filter->GetParameterInfo(0);
    const auto ramp = filter->GetParameterInfo(1);
    const auto locked = filter->GetParameterInfo(2);
    EXPECT_EQ(amount->GetLabel(), u"%");
    EXPECT_EQ(ramp->GetLabel(), u"dB");
    EXPECT_FALSE(amount->CanRamp());
    EXPECT_TRUE(ramp->CanRamp());
    EXPECT_TRUE(amount->CanBeAutomated());
    EXPECT_FALSE(locked->CanBeAutomated());
    filter->SetParameter(0, 0.25F);
    EXPECT_EQ(filter->GetParameter(0), 0.25F);
    EXPECT_EQ(filter->GetParameterString(0), u"25%");
    EXPECT_EQ(amount->GetParameterString(0.9F), u"25%");
    EXPECT_FALSE(amount->SupportsStringForArbitraryValues());

    const FilterPtr silent = Make("NoDisplays");
    silent->SetParameter(0, 0.25F);
    EXPECT_EQ(silent->GetParameterString(0), u"0.25");
}

// Buffers of this host: 128 units for texts of parameters, 64 for a label of the properties, 73 less one for names of
// programs. Neither more nor less is read.
TEST_F(HostedVST2, TextsWithoutAnEndStopAtTheirBuffers)
{
    const FilterPtr filter = Make("FullTexts");
    const auto full = [](const UTF16String& start, std::size_t length)
    {
        return start + UTF16String(length - start.size(), u'+');
    };
    EXPECT_EQ(filter->GetParameterInfo(0)->GetName(), full(u"Amount", 128));
    EXPECT_EQ(filter->GetParameterInfo(0)->GetLabel(), full(u"%", 128));
    EXPECT_EQ(filter->GetParameterInfo(1)->GetLabel(), full(u"dB", 64));
    EXPECT_EQ(filter->GetParameterString(0), full(u"0%", 128));
    EXPECT_EQ(filter->GetFactoryPresetName(1), full(u"Program 2", 72));
    const auto descriptor = Scan(VST2Fixture("FullTexts")).front();
    EXPECT_EQ(descriptor->GetVendorString(), full(u"Zeb Fixtures", 256));
}

TEST_F(HostedVST2, TextsThatAreNoUTF8AreReplacedWhereTheyAreRead)
{
    const FilterPtr filter = Make("IllFormedTexts");
    const char16_t replaced = 0xfffd;
    EXPECT_EQ(filter->GetParameterInfo(0)->GetName(), UTF16String(1, replaced));
    EXPECT_NE(filter->GetParameterInfo(0)->GetLabel().find(replaced), UTF16String::npos);
    EXPECT_NE(filter->GetParameterInfo(1)->GetName().find(replaced), UTF16String::npos);
    EXPECT_EQ(filter->GetParameterInfo(2)->GetName(), u"tab\tbell\a");
    EXPECT_EQ(filter->GetFactoryPresetName(2), u"\u00e4\u00f6");
    PropList list;
    PresetList presets(list);
    filter->GetFactoryDefaultPresets(presets);
    zebcore::UTF8String text;
    zebcore::proplist::utils::WritePropList(text, list);
    PropList read;
    EXPECT_TRUE(zebcore::proplist::utils::ReadPropList(text, read));
}

TEST_F(HostedVST2, APresetOfAProgramEndsInProgramNought)
{
    for (const char* fixture : {"Normal", "Chunks"})
    {
        const FilterPtr filter = Make(fixture);
        EXPECT_EQ(filter->GetFactoryPresetName(2), u"Program 3");
        EXPECT_TRUE(filter->GetFactoryPresetName(3).empty());
        filter->SetParameter(0, 0.125F);
        Recorder().Clear();
        filter->SetFactoryPreset(0);
        filter->SetFactoryPreset(3);
        EXPECT_TRUE(Recorder().Calls().empty());
        filter->SetFactoryPreset(2);
        EXPECT_EQ(Recorder().CallsTo("effSetProgram"), (Lines{"effSetProgram 2", "effSetProgram 0"}));
        EXPECT_EQ(filter->GetParameter(0), 0.5F) << fixture;
    }
}

TEST_F(HostedVST2, AProgramWithoutANameIsNoPreset)
{
    const FilterPtr filter = Make("EmptyProgramName");
    PropList list;
    PresetList presets(list);
    filter->GetFactoryDefaultPresets(presets);
    std::set<UTF16String> names;
    presets.GetPresetNames(names);
    EXPECT_EQ(names, (std::set<UTF16String>{u"Program 1", u"Program 3"}));
    EXPECT_EQ(presets.GetPreset(u"Program 3")->GetFactoryIndex(), 2);
    EXPECT_EQ(presets.GetPreset(u"Program 3")->GetPresetType(), PresetData::kPresetType_Factory);
    EXPECT_EQ(presets.GetPreset(u"Program 1")->GetPresetType(), PresetData::kPresetType_Params);
}

struct ChunkRow
{
    const char* fixture;
    std::size_t bytes; // of what is saved
    float restored;    // of parameter 0, which was 0.75 then and 0 before it was loaded
};

TEST_F(HostedVST2, ChunksComeBackAndBadOnesDoNoHarm)
{
    const ChunkRow rows[] = {{"Chunks", 12, 0.75F},  {"ChunkRefused", 12, 0.0F}, {"ChunkEmpty", 0, 0.0F},
                             {"ChunkNull", 0, 0.0F}, {"ChunkNegative", 0, 0.0F}, {"ChunkLarge", 4194304, 0.75F}};
    for (const ChunkRow& row : rows)
    {
        const FilterPtr filter = Make(row.fixture);
        ASSERT_TRUE(filter->DoPresetsUseChunkData());
        filter->SetParameter(0, 0.75F);
        PropList list;
        PresetData preset(list);
        EXPECT_TRUE(filter->SaveChunkData(preset)) << row.fixture;
        EXPECT_EQ(preset.GetPresetType(), PresetData::kPresetType_Chunk);
        std::vector<unsigned char> chunk;
        preset.GetChunkData(chunk);
        EXPECT_EQ(chunk.size(), row.bytes) << row.fixture;
        filter->SetParameter(0, 0.0F);
        filter->LoadSettings(preset);
        EXPECT_EQ(filter->GetParameter(0), row.restored) << row.fixture;
    }
    const FilterPtr without = Make("Normal");
    PropList list;
    PresetData preset(list);
    EXPECT_FALSE(without->SaveChunkData(preset));
    EXPECT_FALSE(without->LoadChunkData(preset));
}

TEST_F(HostedVST2, LatencyIsReadEachTime)
{
    const FilterPtr filter = Make("Latency");
    EXPECT_EQ(filter->GetInitialDelay(), 321);
    Recorder().Set("latency", 5);
    EXPECT_EQ(filter->GetInitialDelay(), 5);
}

} // namespace
