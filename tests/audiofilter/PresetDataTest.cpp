#include "audiofilter/AudioFilterPresets.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <map>

namespace zebaudiofilterhost
{
namespace
{

using ::testing::ElementsAre;
using ::testing::IsEmpty;

TEST(PresetData, EmptySectionReadsAsDefaults)
{
    PropList list;
    for (PropList* const section : {&list, static_cast<PropList*>(nullptr)})
    {
        PresetData preset(section);
        EXPECT_TRUE(preset.IsEmpty());
        EXPECT_EQ(preset.GetVersion(), 0.0F);
        EXPECT_EQ(preset.GetPresetType(), PresetData::kPresetType_Params);
        EXPECT_EQ(preset.GetFactoryIndex(), -1);
        EXPECT_TRUE(preset.GetFactoryPresetName().empty());
        std::list<float> params{1.0F};
        preset.GetParamList(params);
        EXPECT_THAT(params, IsEmpty());
        std::vector<unsigned char> chunk{1};
        EXPECT_FALSE(preset.GetChunkData(chunk));
        EXPECT_THAT(chunk, IsEmpty());
    }
}

TEST(PresetData, ViewWithoutAPropListIgnoresEverything)
{
    PresetData preset(nullptr);
    int fired = 0;
    preset.GetPresetChangedSignal().connect([&fired](const PresetData&) { ++fired; });
    preset.SetVersion(1.0F);
    preset.SetFactoryIndex(1);
    preset.SetChunkData(nullptr, 0);
    preset.Clear();
    EXPECT_EQ(preset.GetCustomDataSection(), nullptr);
    EXPECT_EQ(preset.GetRawData(), nullptr);
    EXPECT_EQ(fired, 0);
    EXPECT_FALSE(preset == preset);
}

TEST(PresetData, EverySetterSignalsButTheFactoryIndex)
{
    PropList list;
    PresetData preset(list);
    int fired = 0;
    preset.GetPresetChangedSignal().connect(
        [&](const PresetData& changed)
        {
            EXPECT_EQ(&changed, &preset);
            ++fired;
        });
    const unsigned char bytes[] = {1, 2};
    const std::vector<std::function<void()>> setters{
        [&] { preset.SetVersion(2.0F); },           [&] { preset.SetPresetType(PresetData::kPresetType_Chunk); },
        [&] { preset.SetParamList({0.5F}); },       [&] { preset.SetChunkData(bytes, 2); },
        [&] { preset.SetFactoryPresetName(u"A"); },
    };
    for (const auto& setter : setters)
    {
        fired = 0;
        setter();
        EXPECT_EQ(fired, 1);
    }
    fired = 0;
    preset.SetFactoryIndex(3);
    preset.Clear();
    EXPECT_EQ(fired, 0);
    EXPECT_TRUE(list.IsEmpty());
}

TEST(PresetData, StoresUnderItsKeys)
{
    PropList list;
    PresetData preset(list);
    preset.SetVersion(1.5F);
    preset.SetPresetType(PresetData::kPresetType_Factory);
    preset.SetFactoryPresetName(u"Hall");
    preset.SetFactoryIndex(7);
    float version = 0.0F;
    int type = -1;
    int index = -1;
    UTF16String name;
    EXPECT_TRUE(list.GetValue(u8"Version", version) && version == 1.5F);
    EXPECT_TRUE(list.GetValue(u8"Type", type) && type == 2);
    EXPECT_TRUE(list.GetValue(u8"FactoryPreset", name) && name == u"Hall");
    EXPECT_TRUE(list.GetValue(u8"FactoryIndex", index) && index == 7);
}

// Keeps nothing itself, and what it is given in another form.
class MaskedList final : public PropList
{
public:
    using PropList::GetValue;
    using PropList::SetValue;

    void SetValue(const UTF8String& key, const UTF8String& value) override { mTexts[key] = Masked(value); }
    bool GetValue(const UTF8String& key, UTF8String& value) const override
    {
        const auto found = mTexts.find(key);
        if (found != mTexts.end())
            value = Masked(found->second);
        return found != mTexts.end();
    }

private:
    static UTF8String Masked(UTF8String text)
    {
        for (char8_t& unit : text)
            unit = static_cast<char8_t>(unit ^ 1U);
        return text;
    }

    std::map<UTF8String, UTF8String> mTexts;
};

TEST(PresetData, ChunksGoThroughTheAccessorsOfAListOfAnotherKind)
{
    MaskedList list;
    PresetData preset(list);
    const std::vector<unsigned char> bytes{1, 2, 3, 250};
    std::vector<unsigned char> read;
    EXPECT_FALSE(preset.GetChunkData(read));
    preset.SetChunkData(bytes.data(), bytes.size());
    EXPECT_TRUE(preset.GetChunkData(read));
    EXPECT_EQ(read, bytes);
}

TEST(PresetData, ChunksComeBackAndEmptyOnesCountAsMissing)
{
    PropList list;
    PresetData preset(list);
    std::vector<unsigned char> bytes(1000);
    for (std::size_t i = 0; i < bytes.size(); ++i)
        bytes[i] = static_cast<unsigned char>(i * 7);
    preset.SetChunkData(bytes.data(), bytes.size());
    std::vector<unsigned char> read;
    EXPECT_TRUE(preset.GetChunkData(read));
    EXPECT_EQ(read, bytes);
    preset.SetChunkData(nullptr, 0);
    EXPECT_FALSE(preset.GetChunkData(read));
    list.SetValue(u8"ChunkData", u8"%%%");
    EXPECT_FALSE(preset.GetChunkData(read));
}

TEST(PresetData, CopyReplacesTheWholeContent)
{
    PropList from;
    PropList to;
    to.SetValue(u8"Stale", 1);
    PresetData source(from);
    PresetData target(to);
    source.SetParamList({0.1F, std::numeric_limits<float>::infinity()});
    source.GetCustomDataSection()->SetValue(u8"Deep", u"text");
    target.SetDataFromExistingPreset(source);
    int stale = 0;
    EXPECT_FALSE(to.GetValue(u8"Stale", stale));
    std::list<float> params;
    target.GetParamList(params);
    EXPECT_THAT(params, ElementsAre(0.1F, std::numeric_limits<float>::infinity()));
    EXPECT_TRUE(source.IsCustomDataEqual(target));
}

TEST(PresetData, ReadingTheCustomSectionCreatesIt)
{
    PropList list;
    const PresetData preset(list);
    EXPECT_NE(preset.GetCustomDataSection(), nullptr);
    EXPECT_FALSE(preset.IsEmpty());
}

struct EqualityCase
{
    const char* name;
    std::function<void(PresetData&)> left;
    std::function<void(PresetData&)> right;
    bool equal;
};

void Custom(PresetData& preset, int value)
{
    preset.SetPresetType(PresetData::kPresetType_Custom);
    preset.GetCustomDataSection()->SetValue(u8"K", value);
}

void Factory(PresetData& preset, const UTF16String& name, int index)
{
    preset.SetPresetType(PresetData::kPresetType_Factory);
    preset.SetFactoryPresetName(name);
    preset.SetFactoryIndex(index);
}

void Chunk(PresetData& preset, unsigned char byte)
{
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    preset.SetChunkData(&byte, 1);
}

const std::vector<EqualityCase>& EqualityCases()
{
    constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();
    static const std::vector<EqualityCase> sCases{
        {"both empty", [](PresetData&) {}, [](PresetData&) {}, true},
        {"versions", [](PresetData& p) { p.SetVersion(1.0F); }, [](PresetData& p) { p.SetVersion(1.5F); }, false},
        {"NaN version", [](PresetData& p) { p.SetVersion(kNaN); }, [](PresetData& p) { p.SetVersion(kNaN); }, false},
        {"types", [](PresetData& p) { Custom(p, 1); }, [](PresetData& p) { Chunk(p, 1); }, false},
        {"same params",
         [](PresetData& p) {
             p.SetParamList({1, 2});
         },
         [](PresetData& p) {
             p.SetParamList({1, 2});
         },
         true},
        {"more params",
         [](PresetData& p) {
             p.SetParamList({1, 2});
         },
         [](PresetData& p) { p.SetParamList({1}); }, false},
        {"same chunk", [](PresetData& p) { Chunk(p, 1); }, [](PresetData& p) { Chunk(p, 1); }, true},
        {"other chunk", [](PresetData& p) { Chunk(p, 1); }, [](PresetData& p) { Chunk(p, 2); }, false},
        {"one chunk", [](PresetData& p) { Chunk(p, 1); },
         [](PresetData& p) { p.SetPresetType(PresetData::kPresetType_Chunk); }, false},
        {"index ignored", [](PresetData& p) { Factory(p, u"A", 1); }, [](PresetData& p) { Factory(p, u"A", 2); },
         true},
        {"names", [](PresetData& p) { Factory(p, u"A", 1); }, [](PresetData& p) { Factory(p, u"B", 1); }, false},
        {"same custom", [](PresetData& p) { Custom(p, 1); }, [](PresetData& p) { Custom(p, 1); }, true},
        {"other custom", [](PresetData& p) { Custom(p, 1); }, [](PresetData& p) { Custom(p, 2); }, false},
        {"custom, other params", [](PresetData& p) { Custom(p, 1); },
         [](PresetData& p)
         {
             Custom(p, 1);
             p.SetParamList({1});
         },
         false},
        {"unknown type", [](PresetData& p) { p.SetPresetType(PresetData::PresetType(9)); },
         [](PresetData& p) { p.SetPresetType(PresetData::PresetType(9)); }, false},
    };
    return sCases;
}

TEST(PresetData, EqualityGoesByVersionTypeAndTheDataOfTheType)
{
    for (const EqualityCase& c : EqualityCases())
    {
        PropList left;
        PropList right;
        PresetData a(left);
        PresetData b(right);
        c.left(a);
        c.right(b);
        EXPECT_EQ(a == b, c.equal) << c.name;
        EXPECT_EQ(b == a, c.equal) << c.name;
    }
}

TEST(PresetData, CustomComparisonCreatesTheSections)
{
    PropList left;
    PropList right;
    PresetData a(left);
    PresetData b(right);
    EXPECT_TRUE(a.IsCustomDataEqual(b));
    EXPECT_FALSE(left.IsEmpty());
    EXPECT_FALSE(right.IsEmpty());
    const PresetData none(nullptr);
    EXPECT_FALSE(a.IsCustomDataEqual(none));
    EXPECT_TRUE(none.IsCustomDataEqual(none));
}

TEST(PresetList, NamesAreThoseOfTheSubListsInOrder)
{
    PropList list;
    list.SetValue(u8"A value", 1);
    PresetList presets(list);
    presets.AppendPreset(u"\u00e9clair");
    presets.AppendPreset(u"B");
    presets.AppendPreset(u"A");
    std::set<UTF16String> names{u"old"};
    presets.GetPresetNames(names);
    EXPECT_TRUE((names == std::set<UTF16String>{u"A", u"B", u"\u00e9clair"}));
    EXPECT_TRUE(presets.GetPreset(u"\u00e9clair"));
    EXPECT_FALSE(presets.GetPreset(u"A value"));
    EXPECT_FALSE(presets.GetPreset(u"C"));
}

TEST(PresetList, SignalsTellOfChangesAndOfRemovalsInAnyCase)
{
    PropList list;
    PresetList presets(list);
    int fired = 0;
    presets.GetPresetListChangedSignal().connect([&fired](const PresetList&) { ++fired; });
    EXPECT_TRUE(presets.AppendPreset(u"A"));
    EXPECT_EQ(fired, 1);
    EXPECT_FALSE(presets.AppendPreset(u"A"));
    EXPECT_EQ(fired, 1);
    presets.RemovePreset(u"A");
    presets.RemovePreset(u"A");
    EXPECT_EQ(fired, 3);
    presets.Clear();
    EXPECT_EQ(fired, 4);
}

TEST(PresetList, ViewWithoutAPropListIgnoresEverything)
{
    PresetList presets(nullptr);
    EXPECT_FALSE(presets.AppendPreset(u"A"));
    EXPECT_FALSE(presets.GetPreset(u"A"));
    presets.RemovePreset(u"A");
    presets.Clear();
    std::set<UTF16String> names{u"old"};
    presets.GetPresetNames(names);
    EXPECT_TRUE(names.empty());
}

} // namespace
} // namespace zebaudiofilterhost
