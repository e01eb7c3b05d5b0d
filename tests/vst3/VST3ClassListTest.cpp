#include "host/src/VST3/src/VST3ClassList.h"
#include "host/src/VST3/src/VST3FilterID.h"

#include <gtest/gtest.h>

#include <cstring>
#include <functional>
#include <limits>
#include <string>

namespace zebaudiofilterhost::vst3
{

namespace
{

using Steinberg::int32;
using Steinberg::PClassInfo;
using Steinberg::tresult;

constexpr int32 kHuge = std::numeric_limits<int32>::max();

// Its classes are what a test says; class N has the ID N 0 0 0.
class FakeFactory final : public Steinberg::IPluginFactory
{
public:
    FakeFactory(int32 count, std::function<const char*(int32)> categoryOf)
        : mCount(count), mCategoryOf(std::move(categoryOf))
    {
    }

    int GetCalls() const { return mCalls; }

    tresult PLUGIN_API queryInterface(const Steinberg::TUID, void**) override { return Steinberg::kNoInterface; }
    Steinberg::uint32 PLUGIN_API addRef() override { return 1; }
    Steinberg::uint32 PLUGIN_API release() override { return 1; }
    tresult PLUGIN_API getFactoryInfo(Steinberg::PFactoryInfo*) override { return Steinberg::kResultFalse; }
    int32 PLUGIN_API countClasses() override { return mCount; }
    tresult PLUGIN_API getClassInfo(int32 index, PClassInfo* info) override
    {
        ++mCalls;
        const char* category = mCategoryOf(index);
        if (!category)
            return Steinberg::kResultFalse;
        std::memset(info->cid, 0, sizeof(info->cid));
        info->cid[3] = static_cast<char>(index);
        std::strncpy(info->category, category, sizeof(info->category));
        return Steinberg::kResultOk;
    }
    tresult PLUGIN_API createInstance(Steinberg::FIDString, Steinberg::FIDString, void**) override
    {
        return Steinberg::kResultFalse;
    }

private:
    int32 mCount;
    std::function<const char*(int32)> mCategoryOf;
    int mCalls = 0;
};

TEST(VST3ClassList, ListsAudioClassesOnlyInFactoryOrder)
{
    const char* const categories[] = {"Audio Module Class", "Component Controller Class", nullptr,
                                      "audio module class", "Audio Module Class ",        "Audio Module Class"};
    FakeFactory factory(6, [&](int32 index) { return categories[index]; });
    const std::vector<UTF16String> expected = {u"3:00000000 0 0 0", u"3:00000005 0 0 0"};
    EXPECT_TRUE(ListAudioClasses(factory) == expected);
}

TEST(VST3ClassList, FindsClassesOfEveryCategory)
{
    FakeFactory factory(4, [](int32 index) { return index == 1 ? nullptr : "Whatever"; });
    Steinberg::TUID id = {};
    PClassInfo info = {};
    id[3] = 2;
    EXPECT_TRUE(FindClass(factory, id, info));
    EXPECT_EQ(info.cid[3], 2);
    EXPECT_STREQ(info.category, "Whatever");
    id[3] = 1;
    EXPECT_FALSE(FindClass(factory, id, info)) << "the factory cannot describe it";
    EXPECT_EQ(info.cid[3], 2) << "nothing was written";
}

TEST(VST3ClassList, SurvivesCountsThatLie)
{
    for (const int32 count : {0, -1, std::numeric_limits<int32>::min()})
    {
        FakeFactory factory(count, [](int32) { return "Audio Module Class"; });
        EXPECT_TRUE(ListAudioClasses(factory).empty());
        EXPECT_EQ(factory.GetCalls(), 0);
    }
    FakeFactory fewBehindAGap(kHuge, [](int32 index)
                              { return index == 0 || index == 500 ? "Audio Module Class" : nullptr; });
    EXPECT_EQ(ListAudioClasses(fewBehindAGap).size(), 2U);
    EXPECT_LT(fewBehindAGap.GetCalls(), 10000);
    FakeFactory endless(kHuge, [](int32) { return "Audio Module Class"; });
    EXPECT_LT(ListAudioClasses(endless).size(), 40000U);
    EXPECT_LT(endless.GetCalls(), 40000);
}

} // namespace

} // namespace zebaudiofilterhost::vst3
