#include "tests/xau/support/CFTestObjects.h"

#include <gtest/gtest.h>

#include <ctime>
#include <limits>
#include <string>

namespace zebaudiofilterhost::xau
{
namespace
{

CFOwner Parse(std::string_view bytes, CFPropertyListFormat* format = nullptr)
{
    const CFOwner data(MakeBytes(bytes));
    return CFOwner(CFPropertyListCreateWithData(nullptr, static_cast<CFDataRef>(data.get()), 0, format, nullptr));
}

std::string Print(CFPropertyListRef list, CFPropertyListFormat format)
{
    const CFOwner data(CFPropertyListCreateData(nullptr, list, format, 0, nullptr));
    return data ? ToText(static_cast<CFDataRef>(data.get())) : std::string();
}

// Every kind of value, nested.
CFOwner MakeEverything()
{
    CFMutableDictionaryRef inner = MakeDictionary();
    Give(inner, "empty text", MakeString(""));
    Give(inner, "text", MakeString("<&>\n h\xC3\xA9 \xF0\x9F\x8E\xB5"));
    Give(inner, "empty bytes", MakeBytes(""));
    Give(inner, "bytes", MakeBytes(std::string_view("\0\xFF\x7F", 3)));
    CFMutableArrayRef list = CFArrayCreateMutable(nullptr, 0, &kCFTypeArrayCallBacks);
    for (const SInt64 value : {SInt64{0}, SInt64{-1}, SInt64{255}, SInt64{256}, SInt64{70000},
                               std::numeric_limits<SInt64>::max(), std::numeric_limits<SInt64>::min()})
    {
        const CFOwner number(MakeNumber(kCFNumberSInt64Type, value));
        CFArrayAppendValue(list, number.get());
    }
    for (const Float64 value : {0.1, -1e-300, 1.5})
    {
        const CFOwner number(MakeNumber(kCFNumberFloat64Type, value));
        CFArrayAppendValue(list, number.get());
    }
    CFArrayAppendValue(list, kCFBooleanTrue);
    CFArrayAppendValue(list, kCFBooleanFalse);
    Give(inner, "list", list);
    CFMutableDictionaryRef outer = MakeDictionary();
    Give(outer, "inner", inner);
    Give(outer, "date", CFDateCreate(nullptr, 86400.0));
    Give(outer, "empty", MakeDictionary());
    return CFOwner(outer);
}

TEST(PropertyList, BinaryFormGivesBackEverything)
{
    const CFOwner list = MakeEverything();
    const std::string bytes = Print(list.get(), kCFPropertyListBinaryFormat_v1_0);
    CFPropertyListFormat format = {};
    const CFOwner back = Parse(bytes, &format);
    ASSERT_TRUE(back);
    EXPECT_EQ(format, kCFPropertyListBinaryFormat_v1_0);
    EXPECT_TRUE(CFEqual(list.get(), back.get()));
    EXPECT_EQ(Print(back.get(), kCFPropertyListBinaryFormat_v1_0), bytes) << "the same content, other bytes";
}

TEST(PropertyList, XMLFormGivesBackEverything)
{
    CFMutableDictionaryRef list = MakeDictionary();
    const CFOwner owner(list);
    Give(list, "a<b", MakeString("<&> h\xC3\xA9"));
    Give(list, "negative", MakeNumber(kCFNumberSInt64Type, SInt64{-5}));
    Give(list, "real", MakeNumber(kCFNumberFloat64Type, 1.5));
    Give(list, "bytes", MakeBytes("\1\2\3"));
    Give(list, "yes", CFRetain(kCFBooleanTrue));
    CFPropertyListFormat format = {};
    const CFOwner back = Parse(Print(list, kCFPropertyListXMLFormat_v1_0), &format);
    ASSERT_TRUE(back);
    EXPECT_EQ(format, kCFPropertyListXMLFormat_v1_0);
    EXPECT_TRUE(CFEqual(list, back.get()));
}

TEST(PropertyList, EveryCutOrChangedByteGivesAListOrNothing)
{
    const std::string bytes = Print(MakeEverything().get(), kCFPropertyListBinaryFormat_v1_0);
    for (std::size_t size = 0; size < bytes.size(); ++size)
        Parse(std::string_view(bytes).substr(0, size));
    for (std::size_t index = 0; index < bytes.size(); ++index)
    {
        std::string changed = bytes;
        for (const char byte : {'\0', '\x0F', '\x7F', '\xD1', '\xFF'})
        {
            changed[index] = byte;
            Parse(changed);
        }
    }
    EXPECT_FALSE(Parse(""));
    EXPECT_FALSE(Parse("no list"));
    EXPECT_FALSE(Parse("bplist00"));
    EXPECT_FALSE(Parse(std::string_view(bytes).substr(0, bytes.size() - 1)));
}

TEST(PropertyList, ATextWithAZeroEndsNothing)
{
    CFMutableDictionaryRef list = MakeDictionary();
    const CFOwner owner(list);
    Give(list, "key", MakeString("text"));
    Give(list, "k\xC3\xA9y of more than fifteen", MakeString("t\xC3\xA9xt of more than fifteen units"));
    const std::string bytes = Print(list, kCFPropertyListBinaryFormat_v1_0);
    for (const std::string_view part : {"key", "text"})
    {
        std::string changed = bytes;
        changed[changed.find(part) + 1] = '\0';
        EXPECT_FALSE(Parse(changed)) << part;
    }
    for (const std::string_view part : {std::string_view("\0m\0o\0r\0e", 8), std::string_view("\0f\0i\0f\0t", 8)})
    {
        std::string changed = bytes;
        changed[changed.find(part) + 3] = '\0';
        EXPECT_FALSE(Parse(changed)) << "a zero in a wide text";
    }
    Parse("<plist version=\"1.0\"><dict><key>a&#0;b</key><string>a&#0;b</string></dict></plist>");
    EXPECT_FALSE(Parse(std::string_view("<plist version=\"1.0\"><string>a\0b</string></plist>", 47)));
}

TEST(PropertyList, NestingHasABottom)
{
    std::string xml = "<plist version=\"1.0\">";
    for (int depth = 0; depth < 2000; ++depth)
        xml += "<array>";
    EXPECT_FALSE(Parse(xml));

    CFOwner list(CFArrayCreate(nullptr, nullptr, 0, &kCFTypeArrayCallBacks));
    for (int depth = 0; depth < 2000; ++depth)
    {
        const void* value = list.get();
        list = CFOwner(CFArrayCreate(nullptr, &value, 1, &kCFTypeArrayCallBacks));
    }
    EXPECT_EQ(Print(list.get(), kCFPropertyListBinaryFormat_v1_0), "");
}

// A list in binary form, made by hand of objects whose references have two bytes. The first object is the root.
std::string MakeBinary(const std::vector<std::string>& objects)
{
    const auto number = [](std::size_t value, int size)
    {
        std::string bytes;
        for (int shift = 8 * (size - 1); shift >= 0; shift -= 8)
            bytes += static_cast<char>(value >> shift & 0xFF);
        return bytes;
    };
    std::string bytes = "bplist00";
    std::string table;
    for (const std::string& object : objects)
    {
        table += number(bytes.size(), 4);
        bytes += object;
    }
    const std::size_t tableAt = bytes.size();
    return bytes + table + std::string(6, '\0') + "\x04\x02" + number(objects.size(), 8) + number(0, 8) +
           number(tableAt, 8);
}

// An array that has the object so many times, up to 255.
std::string MakeReferences(std::size_t object, std::size_t count)
{
    std::string bytes = {'\xAF', '\x10', static_cast<char>(count)};
    for (std::size_t index = 0; index < count; ++index)
        bytes += {static_cast<char>(object >> 8), static_cast<char>(object & 0xFF)};
    return bytes;
}

// Each array has the next one so many times; the last has a text.
std::string MakeLevels(std::size_t levels, std::size_t count)
{
    std::vector<std::string> objects;
    while (objects.size() < levels)
        objects.push_back(MakeReferences(objects.size() + 1, count));
    objects.emplace_back("\x52hi");
    return MakeBinary(objects);
}

std::string Repeat(const std::string& text, int count)
{
    std::string all;
    for (int index = 0; index < count; ++index)
        all += text;
    return all;
}

TEST(PropertyList, DepthIsBoundedBeforeTheParserRecurses)
{
    constexpr int kTooMany = 200000;
    EXPECT_TRUE(Parse("<plist>" + Repeat("<array>", 250) + Repeat("</array>", 250) + "</plist>"));
    EXPECT_TRUE(Parse("<plist><array>" + Repeat("<array/><dict></dict>", 2000) + "</array></plist>"));
    for (const char* hidden : {"", "<!--</array>-->", "<!-- > </array>-->", "<?x </array>?>", "<array a='/'>",
                               "<array a='</array>'>", "<!DOCTYPE a [ </array> ]>"})
        EXPECT_FALSE(Parse("<plist>" + Repeat("<array>" + std::string(hidden), kTooMany) +
                           Repeat("</array>", kTooMany) + "</plist>"))
            << hidden;
    EXPECT_FALSE(Parse("<plist>" + Repeat("<dict><key>k</key>", kTooMany)));
    EXPECT_TRUE(Parse(MakeLevels(250, 1)));
    EXPECT_FALSE(Parse(MakeLevels(300, 1)));
    EXPECT_FALSE(Parse(MakeLevels(60000, 1)));
}

TEST(PropertyList, SharedObjectsCountAtEachOfTheirPlaces)
{
    const CFOwner shared = Parse(MakeLevels(2, 200));
    ASSERT_TRUE(shared);
    EXPECT_EQ(CFArrayGetCount(static_cast<CFArrayRef>(shared.get())), 200);
    EXPECT_FALSE(Parse(MakeLevels(3, 120)));
    EXPECT_FALSE(Parse(MakeLevels(8, 120)));
    EXPECT_FALSE(Parse(MakeBinary({MakeReferences(0, 1)}))) << "an array in itself";
    EXPECT_FALSE(Parse(MakeBinary({MakeReferences(1, 1), MakeReferences(0, 1)})));

    const std::string text = "\x5F\x12" + std::string("\0\x10\0\0", 4) + std::string(1U << 20U, 'x');
    EXPECT_TRUE(Parse(MakeBinary({MakeReferences(1, 3), text})));
    EXPECT_FALSE(Parse(MakeBinary({MakeReferences(1, 200), text}))) << "200 times a MiB";
}

// Seconds of this thread alone that it takes to read an array of so many items.
double TimeArray(CFIndex count)
{
    CFMutableArrayRef list = CFArrayCreateMutable(nullptr, 0, &kCFTypeArrayCallBacks);
    const CFOwner owner(list);
    for (CFIndex index = 0; index < count; ++index)
        CFArrayAppendValue(list, kCFBooleanTrue);
    const std::string bytes = Print(list, kCFPropertyListBinaryFormat_v1_0);
    const auto seconds = []
    {
        timespec time = {};
        clock_gettime(CLOCK_THREAD_CPUTIME_ID, &time);
        return static_cast<double>(time.tv_sec) + static_cast<double>(time.tv_nsec) * 1e-9;
    };
    const double before = seconds();
    const CFOwner back = Parse(bytes);
    const double spent = seconds() - before;
    EXPECT_TRUE(back && CFEqual(list, back.get())) << count << " items";
    return spent;
}

// In proportion it takes eight times as long, and sixty-four times if each item is looked for from the first one on.
TEST(PropertyList, ALongArrayTakesTimeInProportion)
{
    const double few = TimeArray(10000);
    EXPECT_LT(TimeArray(80000), 24.0 * few + 0.5);
}

// The bytes are in the file once for each time that they are in the list, or once for all times.
TEST(PropertyList, BytesBeyondTheUsualSizeComeBack)
{
    constexpr std::size_t kSize = std::size_t{70} << 20U;
    for (const bool isTwice : {false, true})
    {
        CFMutableDictionaryRef list = MakeDictionary();
        const CFOwner owner(list);
        Give(list, "left", MakeBytes(std::string(kSize, 'x')));
        if (isTwice)
            Give(list, "right", MakeBytes(std::string(kSize, 'x')));
        const CFOwner back = Parse(Print(list, kCFPropertyListBinaryFormat_v1_0));
        ASSERT_TRUE(back) << isTwice;
        EXPECT_TRUE(CFEqual(list, back.get())) << isTwice;
    }
    const std::string bytes = "\x4F\x12" + std::string("\x04\0\0\0", 4) + std::string(std::size_t{64} << 20U, 'x');
    EXPECT_FALSE(Parse(MakeBinary({MakeReferences(1, 200), bytes}))) << "200 times 64 MiB";
}

TEST(PropertyList, WhatIsNoPartOfAListIsRefused)
{
    const std::string path = "/tmp";
    CFMutableDictionaryRef list = MakeDictionary();
    const CFOwner owner(list);
    Give(list, "url",
         CFURLCreateFromFileSystemRepresentation(nullptr, reinterpret_cast<const UInt8*>(path.data()), 4, 1));
    EXPECT_EQ(Print(list, kCFPropertyListBinaryFormat_v1_0), "");

    CFMutableDictionaryRef byNumber = MakeDictionary();
    const CFOwner byNumberOwner(byNumber);
    const CFOwner number(MakeNumber(kCFNumberIntType, 1));
    CFDictionarySetValue(byNumber, number.get(), kCFBooleanTrue);
    EXPECT_EQ(Print(byNumber, kCFPropertyListBinaryFormat_v1_0), "");
    EXPECT_EQ(Print(kCFBooleanTrue, kCFPropertyListOpenStepFormat), "");
}

TEST(PropertyList, GoesThroughStreams)
{
    const CFOwner list = MakeEverything();
    CFWriteStreamRef out = CFWriteStreamCreateWithAllocatedBuffers(nullptr, nullptr);
    const CFOwner outOwner(out);
    EXPECT_EQ(CFPropertyListWrite(list.get(), out, kCFPropertyListBinaryFormat_v1_0, 0, nullptr), 0) << "not open";
    ASSERT_TRUE(CFWriteStreamOpen(out));
    const CFIndex written = CFPropertyListWrite(list.get(), out, kCFPropertyListBinaryFormat_v1_0, 0, nullptr);
    const CFOwner data(CFWriteStreamCopyProperty(out, kCFStreamPropertyDataWritten));
    const auto* bytes = static_cast<CFDataRef>(data.get());
    EXPECT_EQ(CFDataGetLength(bytes), written);

    CFReadStreamRef in =
        CFReadStreamCreateWithBytesNoCopy(nullptr, CFDataGetBytePtr(bytes), written, kCFAllocatorNull);
    const CFOwner inOwner(in);
    EXPECT_EQ(CFPropertyListCreateWithStream(nullptr, in, 0, 0, nullptr, nullptr), nullptr) << "not open";
    ASSERT_TRUE(CFReadStreamOpen(in));
    const CFOwner back(CFPropertyListCreateWithStream(nullptr, in, 0, 0, nullptr, nullptr));
    ASSERT_TRUE(back);
    EXPECT_TRUE(CFEqual(list.get(), back.get()));
}

} // namespace
} // namespace zebaudiofilterhost::xau
