#include "host/src/XAU/src/XAUComponentID.h"
#include "host/XAU/XAUTechnology.h"
#include "tests/xau/support/FakeUnit.h"

#include <gtest/gtest.h>

namespace zebaudiofilterhost::xau
{
namespace
{

TEST(XAUComponentID, IsThreeNumbersWithAndWithoutAPrefix)
{
    const AudioComponentDescription description = {0xFFFFFFFF, 0x61756678, 1, 77, 88};
    EXPECT_EQ(EncodeComponentID(description), u"4294967295 1635083896 1");
    struct Case
    {
        UTF16String text;
        AudioComponentDescription read;
    };
    for (const Case& c :
         {Case{u"4294967295 1635083896 1", {0xFFFFFFFF, 0x61756678, 1, 0, 0}},
          Case{u"4:4294967295 1635083896 1", {0xFFFFFFFF, 0x61756678, 1, 0, 0}}, Case{u"9:7 8 9", {7, 8, 9, 0, 0}},
          Case{u"1  2\t3 4", {1, 2, 3, 0, 0}}, Case{u"1 2", {1, 2, 0, 0, 0}}, Case{u"1 x 3", {1, 0, 0, 0, 0}},
          Case{u"", {}}, Case{u"4:", {4, 0, 0, 0, 0}}, Case{u"42:1 2 3", {42, 0, 0, 0, 0}}})
    {
        const AudioComponentDescription read = DecodeComponentID(c.text);
        EXPECT_EQ(read.componentType, c.read.componentType) << testing::PrintToString(c.text);
        EXPECT_EQ(read.componentSubType, c.read.componentSubType);
        EXPECT_EQ(read.componentManufacturer, c.read.componentManufacturer);
        EXPECT_EQ(read.componentFlags, 0U);
    }
}

TEST(XAUComponentID, NameAndMakerComeFromTheFullName)
{
    struct Case
    {
        const char* fullName;
        UTF16String name;
        UTF16String vendor;
    };
    for (const Case& c : {Case{"Maker: Name", u"Name", u"Maker"}, Case{" \tMaker\t :\t Na me ", u"Na me", u"Maker"},
                          Case{"A:B:C", u"B:C", u"A"}, Case{" Name ", u"Name", u""}, Case{":Name", u":Name", u""},
                          Case{"Maker:", u"", u"Maker"}, Case{"", u"", u""}})
    {
        const FakeUnit unit(kAudioUnitType_Effect, c.fullName);
        UTF16String name = u"before";
        UTF16String vendor = u"before";
        GetNameAndManufacturer(unit.GetComponent(), name, vendor);
        EXPECT_EQ(name, c.name) << c.fullName;
        EXPECT_EQ(vendor, c.vendor) << c.fullName;
    }
    UTF16String name = u"before";
    UTF16String vendor = u"before";
    GetNameAndManufacturer(nullptr, name, vendor);
    EXPECT_EQ(name, u"before");
    EXPECT_EQ(vendor, u"before");
}

} // namespace
} // namespace zebaudiofilterhost::xau
