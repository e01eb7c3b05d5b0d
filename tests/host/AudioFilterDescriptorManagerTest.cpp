#include "host/AudioFilterDescriptorManager.h"

#include "tests/host/CatalogueFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

namespace
{

using Strings = std::vector<std::string>;

void PutDescriptor(PropList& list, const UTF8String& key, const UTF16String& id,
                   const UTF16String& name = u"From file")
{
    AudioFilterDescriptor(VST3(u"/file"), name, u"V", 1, kCategoryNone, id, Guid(), false)
        .Write(list.GetOrCreateSubList(key));
}

class AudioFilterDescriptorManagerTest : public CatalogueFixture
{
protected:
    AudioFilterDescriptorManager& mManager = AudioFilterDescriptorManager::GetInstance();
};

} // namespace

TEST_F(AudioFilterDescriptorManagerTest, SameObjectMovesToTheEnd)
{
    const DescriptorPtr a = MakeExternal(VST3(u"/a"), u"3:a");
    mManager.AddAudioFilterDescriptor(a);
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/b"), u"3:b"));
    mManager.AddAudioFilterDescriptor(a);
    mManager.AddAudioFilterDescriptor(nullptr);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:b", "3:a"}));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:a"), a);
}

TEST_F(AudioFilterDescriptorManagerTest, SameObjectStandsOnceAlsoUnderAnotherID)
{
    const DescriptorPtr descriptor = MakeExternal(VST3(u"/a"), u"3:a");
    mManager.AddAudioFilterDescriptor(descriptor);
    PropList section;
    descriptor->Write(section);
    section.SetValue(u8"id", u"3:b");
    descriptor->Read(section);
    mManager.AddAudioFilterDescriptor(descriptor);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:b"}));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:b"), descriptor);
}

TEST_F(AudioFilterDescriptorManagerTest, FirstObjectOfAnIDAnswersUntilItsMapEntryGoes)
{
    const DescriptorPtr first = MakeExternal(VST3(u"/a"), u"3:x");
    const DescriptorPtr second = MakeExternal(VST3(u"/b"), u"3:x");
    mManager.AddAudioFilterDescriptor(first);
    mManager.AddAudioFilterDescriptor(second);
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:x"), first);
    EXPECT_EQ(mManager.GetExternalInfos(), (AudioFilterDescriptorManager::DescriptorVector{first, second}));

    mManager.AddAudioFilterDescriptor(second);
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:x"), second);

    mManager.ClearInfosForLocator(VST3(u"/none"));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:x"), first);
    EXPECT_EQ(mManager.GetExternalInfos().size(), 2u);

    mManager.ClearInfosForLocator(VST3(u"/a"));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:x"), second);
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:X"), nullptr);
}

TEST_F(AudioFilterDescriptorManagerTest, LegacyIDsTakeOneStepAndTheFirstMappingStays)
{
    const DescriptorPtr current = MakeExternal(VST3(u"/a"), u"3:current");
    mManager.AddAudioFilterDescriptor(current);
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/b"), u"3:shadowed"));
    mManager.AddLegacyToCurrentIDMapping(u"old", u"3:current");
    mManager.AddLegacyToCurrentIDMapping(u"old", u"3:shadowed");
    mManager.AddLegacyToCurrentIDMapping(u"older", u"old");
    mManager.AddLegacyToCurrentIDMapping(u"3:shadowed", u"3:nobody");
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"old"), current);
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"older"), nullptr);
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:shadowed"), nullptr);
}

TEST_F(AudioFilterDescriptorManagerTest, ReplacingKeepsInternalOnesAndTheFirstOfEachID)
{
    const DescriptorPtr internal = MakeInternal(u"gain");
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:a"));
    mManager.AddAudioFilterDescriptor(internal);
    PropList list;
    list.SetValue(u8"num_descriptors", 5);
    PutDescriptor(list, u8"descriptor4", u"3:b");
    PutDescriptor(list, u8"descriptor0", u"3:c", u"first");
    PutDescriptor(list, u8"descriptor1", u"gain");
    PutDescriptor(list, u8"descriptor3", u"3:c", u"second");
    mManager.ReadExternalComponentDescriptors(list, false);
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "3:c", "3:b"}));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"gain"), internal);
    EXPECT_EQ(Text(mManager.GetComponentDescriptorForID(u"3:c")->GetName()), "first");
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:a"), nullptr);

    mManager.ReadExternalComponentDescriptors(PropList(), false);
    EXPECT_EQ(CatalogueIDs(), Strings{"gain"});
}

TEST_F(AudioFilterDescriptorManagerTest, MergingKeepsWhatIsThere)
{
    const DescriptorPtr known = MakeExternal(VST3(u"/a"), u"3:a");
    mManager.AddAudioFilterDescriptor(known);
    PropList list;
    list.SetValue(u8"num_descriptors", 2);
    PutDescriptor(list, u8"descriptor0", u"3:a");
    PutDescriptor(list, u8"descriptor1", u"");
    mManager.ReadExternalComponentDescriptors(list, true);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:a", ""}));
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:a"), known);

    list.SetValue(u8"num_descriptors", -1);
    PutDescriptor(list, u8"descriptor0", u"3:new");
    mManager.ReadExternalComponentDescriptors(list, true);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:a", ""}));
}

TEST_F(AudioFilterDescriptorManagerTest, CountThatLiesCostsNoMoreThanWhatIsThere)
{
    PropList list;
    list.SetValue(u8"num_descriptors", 2147483647);
    PutDescriptor(list, u8"descriptor2147483646", u"3:last");
    PutDescriptor(list, u8"descriptor2147483647", u"3:at the count");
    PutDescriptor(list, u8"descriptor99999999999999999999999", u"3:overflow");
    PutDescriptor(list, u8"descriptor10", u"3:ten");
    PutDescriptor(list, u8"descriptor9", u"3:nine");
    PutDescriptor(list, u8"descriptor07", u"3:leading zero");
    PutDescriptor(list, u8"descriptor-1", u"3:negative");
    PutDescriptor(list, u8"descriptor", u"3:bare");
    list.SetValue(u8"descriptor3", u"no section");
    mManager.ReadExternalComponentDescriptors(list, false);
    EXPECT_EQ(CatalogueIDs(), (Strings{"3:nine", "3:ten", "3:last"}));
}

TEST_F(AudioFilterDescriptorManagerTest, WritesExternalOnesInOrder)
{
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:b"));
    mManager.AddAudioFilterDescriptor(MakeInternal(u"gain"));
    mManager.AddAudioFilterDescriptor(MakeExternal(VST3(u"/a"), u"3:a"));
    PropList list;
    mManager.WriteExternalComponentDescriptors(list);
    EXPECT_EQ(Layout(list), (Strings{"num_descriptors int", "descriptor0 list", "descriptor1 list"}));
    mManager.ClearExternalInfos();
    EXPECT_EQ(CatalogueIDs(), Strings{"gain"});
    EXPECT_EQ(mManager.GetComponentDescriptorForID(u"3:b"), nullptr);
    mManager.ReadExternalComponentDescriptors(list, true);
    EXPECT_EQ(CatalogueIDs(), (Strings{"gain", "3:b", "3:a"}));
}

} // namespace zebaudiofilterhost::testing
