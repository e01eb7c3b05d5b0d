// What a view is made of, without a window.

#include "host/src/XAU/linux/view/ViewPainter.h"
#include "tests/xau/support/DescribedUnit.h"

#include <gtest/gtest.h>

#include <ios>

namespace zebaudiofilterhost::xau
{
namespace
{

class XAUViewPartsTest : public testing::Test
{
protected:
    void SetUp() override
    {
        mUnit.SetParameters({0, 1}, 0.0F, 1.0F);
        mUnit.DescribeSteps(2.0F, {});
        mUnit.Describe(1, kAudioUnitParameterUnit_Indexed,
                       kAudioUnitParameterFlag_IsReadable | kAudioUnitParameterFlag_IsWritable);
        mFilter = mUnit.MakeFilter();
        ASSERT_TRUE(mFilter);
    }

    Float32 Value(AudioUnitParameterID id) { return mUnit.mValues[{kAudioUnitScope_Global, id}]; }

    DescribedUnit mUnit;
    boost::intrusive_ptr<XAUAudioFilter> mFilter;
};

TEST_F(XAUViewPartsTest, StepsHaveFieldsWhileTheirTextsFit)
{
    struct Case
    {
        Float32 last;
        std::vector<const char*> names;
        int width;
        bool hasFields;
        const char* third; // the text of value 2
    };
    const std::vector<const char*> wide = {"Low shelving", "Peak", "High shelving"};
    for (const Case& steps : {Case{2, {}, 480, true, "2"}, Case{7, {}, 480, true, "2"}, Case{8, {}, 2000, false, "2"},
                              Case{15, {}, 2000, false, "2"}, Case{100, {}, 2000, false, "2"},
                              Case{2, {"A", "B", "C"}, 320, true, "C"}, Case{2, wide, 480, false, "High shelving"},
                              Case{2, wide, 1200, true, "High shelving"}, Case{3, {"A"}, 480, true, "2"}})
    {
        mUnit.DescribeSteps(steps.last, steps.names);
        ParameterRow row(mUnit.GetInstance(), kAudioUnitScope_Global, 1);
        EXPECT_EQ(HasStepFields(ViewGeometry::Fit(3, steps.width, 400), row), steps.hasFields)
            << steps.last << " at " << steps.width << ", " << steps.names.size() << " names";
        row.SetPosition((2.0 + 0.4) / static_cast<double>(steps.last));
        EXPECT_EQ(Value(1), 2.0F) << "the nearest step of " << steps.last;
        EXPECT_EQ(row.GetText(), steps.third);
    }
}

TEST_F(XAUViewPartsTest, StepsWhoseNameIsNoTextAreAskedFor)
{
    const FakeUnit::Key strings(kAudioUnitProperty_ParameterValueStrings, kAudioUnitScope_Global, 1);
    CFMutableArrayRef names = CFArrayCreateMutable(nullptr, 0, nullptr); // of bare pointers
    const CFOwner number(MakeNumber(kCFNumberSInt32Type, SInt32{7}));
    const CFOwner text(MakeString("C"));
    for (const void* name : {number.get(), CFTypeRef(nullptr), text.get()})
        CFArrayAppendValue(names, name);
    for (const auto& [answer, last] : {std::pair(CFTypeRef(names), "C"), std::pair(CFRetain(number.get()), "2")})
    {
        mUnit.Answer(strings, answer); // the reference is that of the one row that reads it
        ParameterRow row(mUnit.GetInstance(), kAudioUnitScope_Global, 1);
        for (const auto& [value, shown] : {std::pair(0.0, "0"), std::pair(1.0, "1"), std::pair(2.0, last)})
        {
            row.SetPosition(value / 2.0);
            EXPECT_EQ(row.GetText(), shown) << "last: " << last;
        }
    }
}

TEST_F(XAUViewPartsTest, WhatIsOnlyToBeWatchedHasNothingToTakeHoldOf)
{
    using Control = ParameterRow::Control;
    constexpr UInt32 kUsual = kAudioUnitParameterFlag_IsReadable | kAudioUnitParameterFlag_IsWritable;
    struct Case
    {
        AudioUnitParameterUnit unit;
        UInt32 flags;
        Control control;
        bool isWritable;
        const char* text; // of 1
    };
    for (const Case& each :
         {Case{kAudioUnitParameterUnit_Generic, kUsual, Control::Slider, true, "1.00"},
          Case{kAudioUnitParameterUnit_Decibels, kAudioUnitParameterFlag_IsReadable, Control::Level, false,
               "1.00 dB"},
          Case{kAudioUnitParameterUnit_Generic, kUsual | kAudioUnitParameterFlag_MeterReadOnly, Control::Level, false,
               "1.00"},
          Case{kAudioUnitParameterUnit_Boolean, kUsual, Control::Switch, true, "On"},
          Case{kAudioUnitParameterUnit_Boolean, kAudioUnitParameterFlag_IsReadable, Control::None, false, "On"},
          Case{kAudioUnitParameterUnit_Indexed, kAudioUnitParameterFlag_IsReadable, Control::None, false, "1"},
          Case{kAudioUnitParameterUnit_Generic, kUsual | kAudioUnitParameterFlag_NonRealTime, Control::Slider, true,
               "1.00"}})
    {
        mUnit.Describe(0, each.unit, each.flags);
        mUnit.mValues[{kAudioUnitScope_Global, 0}] = 1.0F;
        const ParameterRow row(mUnit.GetInstance(), kAudioUnitScope_Global, 0);
        EXPECT_EQ(row.GetControl(), each.control) << each.unit << " " << each.flags;
        EXPECT_EQ(row.IsWritable(), each.isWritable) << each.unit << " " << each.flags;
        EXPECT_EQ(row.IsNonRealTime(), (each.flags & kAudioUnitParameterFlag_NonRealTime) != 0);
        EXPECT_EQ(row.GetText(), each.text);
    }
}

// Cairo stops drawing at the first text with a code that is none.
TEST_F(XAUViewPartsTest, NamesOfAnyKindAreDrawn)
{
    const UTF16String longText(100000, u'x');
    EXPECT_EQ(ToShownText(u"a\tb\n\u007fc\u0085"), "a b  c ");
    EXPECT_EQ(ToShownText(UTF16String(u"\0z", 2)), " z");
    EXPECT_EQ(ToShownText(u"\u00e9\U0001D11E"), "\u00e9\U0001D11E");
    EXPECT_LT(ToShownText(longText).size(), 1000U);
    for (const UTF16String& text :
         {UTF16String(1, char16_t(0xD800)), UTF16String(1, char16_t(0xDC00)), UTF16String(1, char16_t(0xFFFF)),
          UTF16String(1, char16_t(0xFDD0)), UTF16String{char16_t(0xD83F), char16_t(0xDFFE)}})
        EXPECT_EQ(ToShownText(u"a" + text + u"b"), "a\uFFFDb") << std::hex << static_cast<unsigned>(text[0]);

    for (const char* name : {"Plain", "\xEF\xBF\xBF"})
    {
        const FakeUnit::Key key(kAudioUnitProperty_ParameterInfo, kAudioUnitScope_Global, 0);
        auto info = mUnit.Read<AudioUnitParameterInfo>(key);
        info.flags |= kAudioUnitParameterFlag_HasCFNameString;
        const CFOwner text(MakeString(name));
        info.cfNameString = static_cast<CFStringRef>(text.get());
        mUnit.Answer(key, info);
        const ParameterRow row(mUnit.GetInstance(), kAudioUnitScope_Global, 0);
        const ViewGeometry geometry = ViewGeometry::Fit(3, 480, 400);
        cairo_surface_t* surface = cairo_image_surface_create(CAIRO_FORMAT_RGB24, geometry.width, geometry.height);
        cairo_t* context = cairo_create(surface);
        PaintView(context, geometry, {&row, &row, &row});
        EXPECT_EQ(cairo_status(context), CAIRO_STATUS_SUCCESS) << name;
        cairo_destroy(context);
        cairo_surface_destroy(surface);
    }
}

TEST(ViewGeometryTest, FitsItsRowsIntoWhatThereIs)
{
    struct Case
    {
        std::size_t rows;
        int width;
        int height;
        std::size_t shown;
    };
    for (const Case& each : {Case{0, 480, 640, 0}, Case{1, 480, 640, 1}, Case{5, 480, 640, 5}, Case{5, 480, 0, 3},
                             Case{2, 480, -9, 2}, Case{24, 480, 640, 23}, Case{32768, 480, 640, 23},
                             Case{32768, 100000, 100000, 156}, Case{32768, -1, 640, 23}})
    {
        const ViewGeometry geometry = ViewGeometry::Fit(each.rows, each.width, each.height);
        EXPECT_EQ(geometry.GetShown(), each.shown) << each.rows << " in " << each.height;
        EXPECT_GE(geometry.width, ViewGeometry::kMinWidth);
        EXPECT_LE(geometry.width, ViewGeometry::kMaxWidth);
        EXPECT_EQ(geometry.ScrolledTo(1000000).first, each.rows - each.shown);
        EXPECT_EQ(geometry.ScrolledTo(-5).first, 0U);
        EXPECT_EQ(geometry.ScrolledToBar(-10000).first, 0U);
        EXPECT_EQ(geometry.ScrolledToBar(10000).first, each.rows - each.shown);
        EXPECT_FALSE(geometry.FindControl(geometry.width / 2, geometry.height - 1));
    }
}

} // namespace
} // namespace zebaudiofilterhost::xau
