#include "host/AudioFilterDescriptor.h"

#include "foundation/zebcore/Localizer.h"
#include "tests/host/CatalogueFixture.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace zebaudiofilterhost::testing
{

TEST(AudioFilterDescriptor, ExternalAndInternalDifferInOriginOnly)
{
    const Guid guid = Guid::CreateUnique();
    const DescriptorPtr external =
        new AudioFilterDescriptor(VST3(u"/p"), u"N", u"V", 7, kCategoryVST3EQ, u"3:id", guid, true);
    const DescriptorPtr internal = new AudioFilterDescriptor(u"N", 7, kCategoryVST3EQ, u"3:id", guid, true);

    EXPECT_EQ(Text(external->GetLocator()), "3:/p");
    EXPECT_EQ(Text(external->GetVendorString()), "V");
    EXPECT_FALSE(external->IsInternal());
    EXPECT_EQ(Text(internal->GetLocator()), "1:");
    EXPECT_EQ(Text(internal->GetVendorString()), "Corvane Systems");
    EXPECT_TRUE(internal->IsInternal());
    for (const DescriptorPtr& descriptor : {external, internal})
    {
        EXPECT_EQ(Text(descriptor->GetName()), "N");
        EXPECT_EQ(descriptor->GetVersion(), 7u);
        EXPECT_EQ(descriptor->GetCategory(), kCategoryVST3EQ);
        EXPECT_EQ(Text(descriptor->GetUniqueID()), "3:id");
        EXPECT_TRUE(descriptor->GetFactoryGuid() == guid);
        EXPECT_TRUE(descriptor->IsEnabled());
        EXPECT_TRUE(descriptor->IsSynth());
        EXPECT_FALSE(descriptor->GetSupportsMono());
        EXPECT_FALSE(descriptor->GetSupportsStereo());
    }
}

TEST(AudioFilterDescriptor, EmptySectionGivesDefaultsThatCountAsExternal)
{
    const DescriptorPtr descriptor = new AudioFilterDescriptor(PropList());
    EXPECT_EQ(Text(descriptor->GetLocator()), "0:");
    EXPECT_FALSE(descriptor->IsInternal());
    EXPECT_EQ(descriptor->GetCategory(), kCategoryNone);
    EXPECT_TRUE(descriptor->GetFactoryGuid() == Guid());
    EXPECT_TRUE(descriptor->IsEnabled());
    EXPECT_FALSE(descriptor->IsSynth());
}

TEST(AudioFilterDescriptor, SectionKeepsOrderTypesAndEveryField)
{
    AudioFilterDescriptor written(VST3(u"/p:q"), UTF16String(u"N\0\xdc00", 3), u"V", 4294967295u, kCategoryNotQueried,
                                  u"3:id", Guid::CreateUnique(), true);
    written.SetEnabled(false);
    written.SetSupportsMono(true);
    written.SetSupportsStereo(true);
    PropList list;
    written.Write(list);
    EXPECT_EQ(Layout(list), (std::vector<std::string>{"locator text", "name text", "vendor text", "version unsigned",
                                                      "category int", "id text", "factory_guid text", "enabled bool",
                                                      "synth bool", "mono bool", "stereo bool"}));

    const AudioFilterDescriptor read(list);
    EXPECT_TRUE(read.GetLocator() == written.GetLocator());
    EXPECT_TRUE(read.GetName() == written.GetName());
    EXPECT_TRUE(read.GetVendorString() == written.GetVendorString());
    EXPECT_EQ(read.GetVersion(), written.GetVersion());
    EXPECT_EQ(read.GetCategory(), written.GetCategory());
    EXPECT_TRUE(read.GetUniqueID() == written.GetUniqueID());
    EXPECT_TRUE(read.GetFactoryGuid() == written.GetFactoryGuid());
    EXPECT_FALSE(read.IsEnabled());
    EXPECT_TRUE(read.IsSynth());
    EXPECT_TRUE(read.GetSupportsMono());
    EXPECT_TRUE(read.GetSupportsStereo());
}

TEST(AudioFilterDescriptor, ReadingAgainReplacesOnlyWhatHasNoSafeOldValue)
{
    AudioFilterDescriptor descriptor(VST3(u"/p"), u"N", u"V", 7, kCategoryVST3EQ, u"3:id", Guid::CreateUnique(),
                                     true);
    PropList list;
    list.SetValue(u8"vendor", u"Other");
    list.SetValue(u8"version", u"not a number");
    descriptor.Read(list);
    EXPECT_EQ(Text(descriptor.GetLocator()), "0:");
    EXPECT_EQ(descriptor.GetCategory(), kCategoryNone);
    EXPECT_TRUE(descriptor.GetFactoryGuid() == Guid());
    EXPECT_EQ(Text(descriptor.GetName()), "N");
    EXPECT_EQ(Text(descriptor.GetVendorString()), "Other");
    EXPECT_EQ(descriptor.GetVersion(), 7u);
    EXPECT_EQ(Text(descriptor.GetUniqueID()), "3:id");
    EXPECT_TRUE(descriptor.IsSynth());
}

TEST(AudioFilterDescriptor, CategoryNames)
{
    const std::vector<std::string> names = {"",
                                            "Effect",
                                            "Synth",
                                            "Analysis",
                                            "Mastering",
                                            "Spacializer",
                                            "RoomFx",
                                            "SurroundFx",
                                            "Restoration",
                                            "Offline",
                                            "Generator",
                                            "Analyzer",
                                            "Delay",
                                            "Distortion",
                                            "Dynamics",
                                            "EQ",
                                            "Filter",
                                            "Instrument",
                                            "Spatial",
                                            "Generator",
                                            "Mastering",
                                            "Modulation",
                                            "Pitch Shift",
                                            "Restoration",
                                            "Reverb",
                                            "Surround",
                                            "Tools",
                                            "",
                                            ""};
    const auto nameOf = [](int category)
    {
        PropList list;
        list.SetValue(u8"category", category);
        return Text(AudioFilterDescriptor(list).GetCategoryName());
    };
    for (std::size_t category = 0; category < names.size(); ++category)
    {
        EXPECT_EQ(nameOf(static_cast<int>(category)), names[category]) << category;
    }
    EXPECT_EQ(nameOf(-1), "");
    EXPECT_EQ(nameOf(2147483647), "");

    zebcore::config::Localizer& localizer = zebcore::config::Localizer::Get();
    localizer.AddTranslation("$$$/zebaudiofilterhost/componentdescriptor/category/OfflineProcess", u"Hors ligne");
    EXPECT_EQ(nameOf(kCategoryOfflineProcess), "Hors ligne");
    localizer.ClearTranslations();
}

} // namespace zebaudiofilterhost::testing
