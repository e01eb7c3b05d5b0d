#include "audiofilter/AudioFilterPresets.h"
#include "foundation/zebcore/Trace.h"

#include <gtest/gtest.h>

#include <string>

namespace zebaudiofilterhost
{
namespace
{

class FactoryPresetListFormat : public ::testing::Test
{
protected:
    FactoryPresetListFormat() : mPresets(new PresetList(mList))
    {
        zebcore::debug::SetDebugTraceSink([this](std::string_view text) { mText.append(text); });
    }
    ~FactoryPresetListFormat() override { zebcore::debug::SetDebugTraceSink({}); }

    void Add(const UTF16String& name, float version, PresetData::PresetType type, const std::list<float>& params)
    {
        const auto preset = mPresets->AppendPreset(name);
        preset->SetVersion(version);
        preset->SetPresetType(type);
        preset->SetParamList(params);
    }

    PropList mList;
    boost::intrusive_ptr<PresetList> mPresets;
    std::string mText;
};

TEST_F(FactoryPresetListFormat, PrintsATableWithPlaceholdersForWhatDiffers)
{
    Add(u"A chunk", 1.0F, PresetData::kPresetType_Chunk, {});
    Add(u"B", 2.0F, PresetData::kPresetType_Params, {0.1F, 1.0F});
    Add(u"Caf\u00e9", 2.0F, PresetData::kPresetType_Params, {0.0F, -2.5F});
    Add(u"D other version", 1.0F, PresetData::kPresetType_Params, {0.1F, 1.0F});
    Add(u"E other count", 2.0F, PresetData::kPresetType_Params, {0.1F});
    FormatFactoryPresetList(mPresets);
    EXPECT_EQ(mText, "const int kNumFactoryPresets = 5;\n"
                     "const int kNumFactoryParams = 2;\n"
                     "\n"
                     "struct PresetData\n"
                     "{\n"
                     "\tchar*\t\tName;\n"
                     "\tfloat\t\tParams[kNumFactoryParams];\n"
                     "};\n"
                     "\n"
                     "PresetData sPresets[kNumFactoryPresets] = {\n"
                     "\t  { \"A chunk\", {  ***placeholder***}}\n"
                     "\t, { \"B\", {   0.10000000f, 1.0000000f}}\n"
                     "\t, { \"Caf\xc3\xa9\", {   0.0000000f, -2.5000000f}}\n"
                     "\t, { \"D other version\", {  ***placeholder***}}\n"
                     "\t, { \"E other count\", {  ***placeholder***}}\n"
                     "};\n");
}

TEST_F(FactoryPresetListFormat, AZeroInANameEndsNothing)
{
    Add(UTF16String(u"A\0", 2), 1.0F, PresetData::kPresetType_Params, {0.5F});
    FormatFactoryPresetList(mPresets);
    EXPECT_TRUE(mText.ends_with("\t  { \"A\", {   0.50000000f}}\n};\n")) << mText;
}

TEST_F(FactoryPresetListFormat, PrintsNothingWithoutAPresetOfParameters)
{
    FormatFactoryPresetList(boost::intrusive_ptr<PresetList>());
    FormatFactoryPresetList(mPresets);
    Add(u"A", 1.0F, PresetData::kPresetType_Chunk, {});
    FormatFactoryPresetList(mPresets);
    EXPECT_EQ(mText, "");
}

} // namespace
} // namespace zebaudiofilterhost
