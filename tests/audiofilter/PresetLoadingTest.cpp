// Settings on their way into and out of a filter.
#include "tests/audiofilter/RecordingFilter.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace zebaudiofilterhost
{
namespace
{

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using PD = PresetData;

// A filter whose preset answers are set from outside.
class PresetFilter : public testing::RecordingFilter
{
public:
    PresetFilter() : RecordingFilter({}, {}) {}

    float GetCurrentPresetVersion() const override { return mVersion; }
    bool DoPresetsUseChunkData() const override { return mUsesChunk; }
    bool LoadChunkData(const PresetData&) override
    {
        ++mChunksLoaded;
        return false;
    }
    bool LoadCustomData(const PresetData&) override { return mCustomResult; }
    int GetNumFactoryPresets() const override { return static_cast<int>(mNames.size()); }
    UTF16String GetFactoryPresetName(int index) const override
    {
        return index >= 0 && index < GetNumFactoryPresets() ? mNames[static_cast<std::size_t>(index)] : UTF16String();
    }
    void SetFactoryPreset(int index) override { mFactoryPresetsSet.push_back(index); }

    float mVersion = 1.0F;
    bool mUsesChunk = false;
    bool mCustomResult = false;
    int mChunksLoaded = 0;
    std::vector<UTF16String> mNames;
    std::vector<int> mFactoryPresetsSet;
};

class PresetLoadingTest : public ::testing::Test
{
protected:
    PresetLoadingTest() : mFilter(new PresetFilter), mPreset(mList)
    {
        mPreset.SetVersion(1.0F);
        mFilter->ConnectPresetChanged(
            [this]
            {
                EXPECT_FALSE(mFilter->IsLoadingSettings());
                ++mPresetChanges;
            });
    }

    // Loads, and checks what every load does, refused or not.
    bool Load()
    {
        mPresetChanges = 0;
        const std::size_t calls = mFilter->mParameterCalls.size();
        const unsigned int dirty = mFilter->GetParameterDirtyCount();
        const bool loaded = mFilter->LoadSettings(mPreset);
        EXPECT_EQ(mPresetChanges, 1);
        EXPECT_EQ(mFilter->GetParameterDirtyCount(), dirty + 1 + (mFilter->mParameterCalls.size() - calls));
        return loaded;
    }

    void MakeFactory(const UTF16String& name, int index)
    {
        mPreset.SetPresetType(PD::kPresetType_Factory);
        mPreset.SetFactoryPresetName(name);
        mPreset.SetFactoryIndex(index);
    }

    boost::intrusive_ptr<PresetFilter> mFilter;
    PropList mList;
    PresetData mPreset;
    int mPresetChanges = 0;
};

TEST_F(PresetLoadingTest, TypeAndVersionDecide)
{
    struct Case
    {
        PD::PresetType type;
        float version;
        bool usesChunk;
        bool customResult;
        bool loaded;
    };
    const std::vector<Case> cases{
        {PD::kPresetType_Params, 1.0F, false, false, true}, // No parameters on either side
        {PD::kPresetType_Params, 1.0F, true, false, false},
        {PD::kPresetType_Params, 0.0F, false, false, false},
        {PD::kPresetType_Params, 1.5F, false, false, false},
        {PD::kPresetType_Chunk, 1.0F, true, false, true}, // Although the plug-in refuses the chunk
        {PD::kPresetType_Chunk, 1.0F, false, false, false},
        {PD::kPresetType_Custom, 1.0F, false, true, true},
        {PD::kPresetType_Custom, 1.0F, true, false, false},
        {PD::PresetType(4), 1.0F, false, true, false},
        {PD::PresetType(-1), 1.0F, false, true, false},
    };
    for (std::size_t i = 0; i < cases.size(); ++i)
    {
        mPreset.SetPresetType(cases[i].type);
        mPreset.SetVersion(cases[i].version);
        mFilter->mUsesChunk = cases[i].usesChunk;
        mFilter->mCustomResult = cases[i].customResult;
        EXPECT_EQ(Load(), cases[i].loaded) << "case " << i;
    }
    EXPECT_EQ(mFilter->mChunksLoaded, 1);
}

TEST_F(PresetLoadingTest, APresetWithoutAVersionFitsVersionZeroOnly)
{
    mList.Clear();
    EXPECT_FALSE(Load());
    mFilter->mVersion = 0.0F;
    EXPECT_TRUE(Load());
}

TEST_F(PresetLoadingTest, ParametersAreSetAsAutomatedAndOnlyIfTheirCountFits)
{
    mFilter->mParameters.resize(3);
    std::vector<std::pair<int, float>> heard;
    mFilter->ConnectAutomatedParameterChange([&](int index, float value) { heard.emplace_back(index, value); });
    mPreset.SetParamList({0.1F, 0.2F});
    EXPECT_FALSE(Load());
    EXPECT_THAT(heard, IsEmpty());
    mPreset.SetParamList({0.1F, 0.2F, 0.3F});
    EXPECT_TRUE(Load());
    EXPECT_THAT(heard, ElementsAre(std::pair(0, 0.1F), std::pair(1, 0.2F), std::pair(2, 0.3F)));
}

TEST_F(PresetLoadingTest, FactoryPresetsAreFoundByIndexThenByName)
{
    mFilter->mNames = {u"A", u"B", u"C", u"D", u"B", u"E"};
    struct Case
    {
        UTF16String name;
        int index;
        bool loaded;
        std::vector<int> set;
    };
    const std::vector<Case> cases{
        {u"C", 2, true, {2}},     {u"E", 3, true, {5}},    {u"E", -1, true, {5}},
        {u"B", -1, true, {1, 4}}, {u"B", 1, true, {1}},    {u"gone", 2, false, {}},
        {u"A", 100, true, {0}},   {u"A", -100, true, {0}}, {u"", -2, false, {}},
    };
    for (std::size_t i = 0; i < cases.size(); ++i)
    {
        mFilter->mFactoryPresetsSet.clear();
        MakeFactory(cases[i].name, cases[i].index);
        EXPECT_EQ(Load(), cases[i].loaded) << "case " << i;
        EXPECT_EQ(mFilter->mFactoryPresetsSet, cases[i].set) << "case " << i;
    }
}

TEST_F(PresetLoadingTest, SavingReplacesTheContent)
{
    mList.SetValue(u8"Stale", 1);
    mFilter->mParameters = {0.25F, 0.75F};
    mFilter->SaveSettings(mPreset);
    int stale = 0;
    EXPECT_FALSE(mList.GetValue(u8"Stale", stale));
    EXPECT_EQ(mPreset.GetVersion(), 1.0F);
    EXPECT_EQ(mPreset.GetPresetType(), PD::kPresetType_Params);
    std::list<float> params;
    mPreset.GetParamList(params);
    EXPECT_THAT(params, ElementsAre(0.25F, 0.75F));

    mFilter->mUsesChunk = true;
    mFilter->SaveSettings(mPreset);
    EXPECT_EQ(mPreset.GetPresetType(), PD::kPresetType_Chunk);
    mPreset.GetParamList(params);
    EXPECT_THAT(params, IsEmpty());
}

TEST_F(PresetLoadingTest, FactoryDefaultsSkipEmptyAndDoubleNames)
{
    mFilter->mNames = {u"A", u"", u"B", u"A"};
    mFilter->mVersion = 3.0F;
    PropList list;
    PresetList presets(list);
    presets.AppendPreset(u"old");
    mFilter->GetFactoryDefaultPresets(presets);
    std::set<UTF16String> names;
    presets.GetPresetNames(names);
    EXPECT_TRUE((names == std::set<UTF16String>{u"A", u"B"}));
    const auto preset = presets.GetPreset(u"B");
    EXPECT_EQ(preset->GetVersion(), 3.0F);
    EXPECT_EQ(preset->GetPresetType(), PD::kPresetType_Factory);
    EXPECT_TRUE(preset->GetFactoryPresetName() == u"B");
    EXPECT_EQ(preset->GetFactoryIndex(), -1);
}

TEST_F(PresetLoadingTest, LoadingIsMarkedWhileItLasts)
{
    mFilter->mParameters.resize(1);
    bool loading = false;
    mFilter->ConnectAutomatedParameterChange([&](int, float) { loading = mFilter->IsLoadingSettings(); });
    mPreset.SetParamList({0.5F});
    EXPECT_TRUE(Load());
    EXPECT_TRUE(loading);
}

} // namespace
} // namespace zebaudiofilterhost
