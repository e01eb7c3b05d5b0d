#include "audiofilter/PresetData.h"
#include "tests/xau/support/CFTestObjects.h"
#include "tests/xau/support/FakeUnit.h"
#include "tests/xau/support/TestClock.h"

#include <gmock/gmock.h>

#include <array>

namespace zebaudiofilterhost::xau
{
namespace
{

class XAUPresetsTest : public testing::Test
{
protected:
    void SetUp() override { mUnit.SetParameters({1}, 0.0F, 1.0F); }

    // How often the value listener of the filter was told.
    int CountTold()
    {
        int told = 0;
        const boost::signals2::scoped_connection connection =
            mFilter->GetAutomatedParameterChangeSignal().connect([&](int, float) { ++told; });
        mClock.Pass(50);
        return told;
    }

    TestClock mClock;
    FakeUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
    PropList mList; // outlives the view of it
    boost::intrusive_ptr<PresetData> mPreset{new PresetData(&mList)};
};

TEST_F(XAUPresetsTest, TheClassInfoIsThePresetAndIsNotReleased)
{
    CFMutableDictionaryRef classInfo = MakeDictionary();
    const CFOwner owner(classInfo);
    Give(classInfo, "name", MakeString("Untitled"));
    Give(classInfo, "data", MakeBytes(std::string_view("\0\1", 2)));
    Give(classInfo, "version", MakeNumber(kCFNumberSInt32Type, SInt32{-1}));
    mUnit.Answer(Global(kAudioUnitProperty_ClassInfo), static_cast<CFPropertyListRef>(classInfo));
    mFilter = mUnit.MakeFilter();
    ASSERT_TRUE(mFilter->SaveChunkData(*mPreset));
    EXPECT_EQ(CFGetRetainCount(classInfo), 1);
    EXPECT_EQ(mPreset->GetVersion(), mFilter->GetCurrentPresetVersion());
    EXPECT_EQ(mPreset->GetPresetType(), PresetData::kPresetType_Chunk);
    std::vector<unsigned char> chunk;
    ASSERT_TRUE(mPreset->GetChunkData(chunk));
    EXPECT_EQ(std::string(chunk.begin(), chunk.begin() + 8), "bplist00");

    mUnit.Forget(Global(kAudioUnitProperty_ClassInfo));
    ASSERT_TRUE(mFilter->LoadChunkData(*mPreset));
    EXPECT_EQ(CountTold(), 1) << "all parameters are told of";
    EXPECT_EQ(mUnit.CountCalls("set 0 0 0"), 1U);
}

TEST_F(XAUPresetsTest, TheBytesHoldTheWholeListAndAreTheSameEachTime)
{
    CFMutableDictionaryRef classInfo = MakeDictionary();
    const CFOwner owner(classInfo);
    Give(classInfo, "10", MakeNumber(kCFNumberFloat64Type, 0.1));
    Give(classInfo, "nested", MakeDictionary());
    mUnit.Answer(Global(kAudioUnitProperty_ClassInfo), static_cast<CFPropertyListRef>(classInfo));
    mFilter = mUnit.MakeFilter();
    ASSERT_TRUE(mFilter->SaveChunkData(*mPreset));
    std::vector<unsigned char> first;
    mPreset->GetChunkData(first);
    ASSERT_TRUE(mFilter->SaveChunkData(*mPreset));
    std::vector<unsigned char> second;
    mPreset->GetChunkData(second);
    EXPECT_TRUE(first == second) << "saved twice without a change";
    const CFOwner data(CFDataCreate(nullptr, first.data(), static_cast<CFIndex>(first.size())));
    const CFOwner back(
        CFPropertyListCreateWithData(nullptr, static_cast<CFDataRef>(data.get()), 0, nullptr, nullptr));
    ASSERT_TRUE(back);
    EXPECT_TRUE(CFEqual(back.get(), classInfo));
}

TEST_F(XAUPresetsTest, AUnitMayKeepItsSamplesThere)
{
    CFMutableDictionaryRef classInfo = MakeDictionary();
    const CFOwner owner(classInfo);
    Give(classInfo, "samples", MakeBytes(std::string(std::size_t{70} << 20U, 'x')));
    const FakeUnit::Key key = Global(kAudioUnitProperty_ClassInfo);
    mUnit.Answer(key, static_cast<CFPropertyListRef>(classInfo));
    mFilter = mUnit.MakeFilter();
    ASSERT_TRUE(mFilter->SaveChunkData(*mPreset));
    mUnit.Forget(key);
    EXPECT_TRUE(mFilter->LoadChunkData(*mPreset));
    EXPECT_TRUE(mUnit.Has(key));
}

TEST_F(XAUPresetsTest, FailuresAreToldAndLeaveTheUnitAlone)
{
    mFilter = mUnit.MakeFilter();
    EXPECT_FALSE(mFilter->SaveChunkData(*mPreset)) << "no class info";
    EXPECT_FALSE(mFilter->LoadChunkData(*mPreset)) << "no chunk";
    const std::array<unsigned char, 4> nonsense = {1, 2, 3, 4};
    mPreset->SetChunkData(nonsense.data(), nonsense.size());
    EXPECT_FALSE(mFilter->LoadChunkData(*mPreset));
    EXPECT_EQ(mUnit.CountCalls("set 0 0 0"), 0U);

    mUnit.Answer(Global(kAudioUnitProperty_ClassInfo), static_cast<CFPropertyListRef>(kCFBooleanTrue));
    ASSERT_TRUE(mFilter->SaveChunkData(*mPreset));
    mUnit.mRefused = {Global(kAudioUnitProperty_ClassInfo)};
    EXPECT_FALSE(mFilter->LoadChunkData(*mPreset));
    EXPECT_EQ(CountTold(), 0);

    mUnit.mRefused.clear();
    mUnit.Answer(Global(kAudioUnitProperty_ClassInfo), static_cast<CFPropertyListRef>(kCFAllocatorNull));
    EXPECT_TRUE(mFilter->SaveChunkData(*mPreset)) << "a list that cannot be written is a preset of no bytes";
    EXPECT_FALSE(mFilter->LoadChunkData(*mPreset));
}

TEST_F(XAUPresetsTest, FactoryPresetsAreTheUnitsRecords)
{
    const CFOwner name(MakeString("Hall"));
    std::array<AUPreset, 2> presets = {AUPreset{7, static_cast<CFStringRef>(name.get())}, AUPreset{8, nullptr}};
    std::array<const void*, 3> pointers = {presets.data(), presets.data() + 1, nullptr};
    const CFOwner list(CFArrayCreate(nullptr, pointers.data(), 3, nullptr));
    CFRetain(list.get()); // for the filter, which releases it
    mUnit.Answer(Global(kAudioUnitProperty_FactoryPresets), list.get());
    mFilter = mUnit.MakeFilter();
    ASSERT_EQ(mFilter->GetNumFactoryPresets(), 3);
    EXPECT_EQ(mFilter->GetFactoryPresetName(0), u"Hall");
    for (const int index : {1, 2, 3, -1})
        EXPECT_EQ(mFilter->GetFactoryPresetName(index), u"") << index;
    for (const int index : {2, 3, -1})
        mFilter->SetFactoryPreset(index);
    EXPECT_EQ(mUnit.CountCalls("set 36 0 0"), 0U);
    mFilter->SetFactoryPreset(0);
    EXPECT_EQ(mUnit.Read<AUPreset>(Global(kAudioUnitProperty_PresentPreset)).presetNumber, 7);
    EXPECT_EQ(CountTold(), 1);
    mUnit.mRefused = {Global(kAudioUnitProperty_PresentPreset)};
    mFilter->SetFactoryPreset(1);
    EXPECT_EQ(CountTold(), 0);
    mFilter.reset();
    EXPECT_EQ(CFGetRetainCount(list.get()), 1);
    EXPECT_EQ(CFGetRetainCount(name.get()), 1);
}

} // namespace
} // namespace zebaudiofilterhost::xau
