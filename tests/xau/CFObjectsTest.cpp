#include "tests/xau/support/CFTestObjects.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <cstring>
#include <limits>

namespace zebaudiofilterhost::xau
{
namespace
{

TEST(CFObjects, ContainersHoldAReferenceOnEachValueAndGiveItBack)
{
    const CFOwner value(MakeString("value"));
    {
        CFMutableArrayRef array = CFArrayCreateMutable(nullptr, 0, &kCFTypeArrayCallBacks);
        const CFOwner arrayOwner(array);
        CFArrayAppendValue(array, value.get());
        CFArrayAppendValue(array, value.get());
        EXPECT_EQ(CFGetRetainCount(value.get()), 3);
        const CFOwner copy(CFArrayCreateCopy(nullptr, array));
        EXPECT_EQ(CFGetRetainCount(value.get()), 5);
        CFArrayRemoveAllValues(array);
        EXPECT_EQ(CFGetRetainCount(value.get()), 3);
        EXPECT_EQ(CFArrayGetCount(static_cast<CFArrayRef>(copy.get())), 2);
    }
    EXPECT_EQ(CFGetRetainCount(value.get()), 1);
    {
        CFMutableDictionaryRef dictionary = MakeDictionary();
        const CFOwner owner(dictionary);
        CFDictionarySetValue(dictionary, value.get(), value.get());
        CFDictionarySetValue(dictionary, value.get(), kCFBooleanTrue); // the value goes, the key stays
        EXPECT_EQ(CFGetRetainCount(value.get()), 2);
        CFDictionaryRemoveValue(dictionary, value.get());
        EXPECT_EQ(CFGetRetainCount(value.get()), 1);
    }
}

TEST(CFObjects, BarePointersAreNeitherRetainedNorReleased)
{
    std::array<AUPreset, 2> presets = {AUPreset{1, nullptr}, AUPreset{2, nullptr}};
    std::array<const void*, 2> pointers = {presets.data(), presets.data() + 1};
    const CFOwner owner(CFArrayCreate(nullptr, pointers.data(), 2, nullptr));
    const auto* array = static_cast<CFArrayRef>(owner.get());
    EXPECT_EQ(static_cast<const AUPreset*>(CFArrayGetValueAtIndex(array, 1))->presetNumber, 2);
}

TEST(CFObjects, EqualMeansTheSameContentOfTheSameKind)
{
    const CFOwner text(MakeString("1"));
    const CFOwner sameText(MakeString("1"));
    const CFOwner integer(MakeNumber(kCFNumberSInt8Type, SInt8{1}));
    const CFOwner real(MakeNumber(kCFNumberFloat64Type, 1.0));
    const CFOwner other(MakeNumber(kCFNumberFloat64Type, 1.5));
    EXPECT_TRUE(CFEqual(text.get(), sameText.get()));
    EXPECT_EQ(CFHash(text.get()), CFHash(sameText.get()));
    EXPECT_TRUE(CFEqual(integer.get(), real.get()));
    EXPECT_EQ(CFHash(integer.get()), CFHash(real.get()));
    EXPECT_FALSE(CFEqual(real.get(), other.get()));
    EXPECT_FALSE(CFEqual(text.get(), integer.get()));
    EXPECT_FALSE(CFEqual(kCFBooleanTrue, integer.get()));

    CFMutableDictionaryRef one = MakeDictionary();
    CFMutableDictionaryRef two = MakeDictionary();
    const CFOwner oneOwner(one);
    const CFOwner twoOwner(two);
    Give(one, "a", CFRetain(text.get()));
    Give(one, "b", CFRetain(real.get()));
    Give(two, "b", CFRetain(integer.get()));
    EXPECT_FALSE(CFEqual(one, two));
    Give(two, "a", CFRetain(sameText.get()));
    EXPECT_TRUE(CFEqual(one, two)) << "the order of setting counts for nothing";
}

TEST(CFObjects, NumbersSayWhetherTheySurviveAConversion)
{
    struct Case
    {
        Float64 from;
        SInt16 to;
        bool survives;
    };
    for (const Case& c : {Case{-3.0, -3, true}, Case{3.5, 3, false}, Case{-3.5, -3, false}, Case{1e9, 32767, false},
                          Case{-1e300, -32768, false}, Case{std::nan(""), 0, false}, Case{32767.0, 32767, true},
                          Case{32768.0, 32767, false}, Case{-32768.0, -32768, true}})
    {
        const CFOwner owner(MakeNumber(kCFNumberFloat64Type, c.from));
        SInt16 value = 1;
        EXPECT_EQ(CFNumberGetValue(static_cast<CFNumberRef>(owner.get()), kCFNumberSInt16Type, &value) != 0,
                  c.survives)
            << c.from;
        EXPECT_EQ(value, c.to) << c.from;
    }
    const CFOwner wide(MakeNumber(kCFNumberSInt64Type, std::numeric_limits<SInt64>::max()));
    const auto* number = static_cast<CFNumberRef>(wide.get());
    SInt32 narrow = 0;
    EXPECT_FALSE(CFNumberGetValue(number, kCFNumberSInt32Type, &narrow));
    Float64 real = 0.0;
    EXPECT_FALSE(CFNumberGetValue(number, kCFNumberFloat64Type, &real)) << "53 bits are too few";
    SInt64 same = 0;
    EXPECT_TRUE(CFNumberGetValue(number, kCFNumberLongLongType, &same));
    EXPECT_EQ(same, std::numeric_limits<SInt64>::max());
    EXPECT_EQ(CFNumberCreate(nullptr, static_cast<CFNumberType>(99), &same), nullptr);
}

TEST(CFObjects, TextsKeepTheirUnitsAndRefuseWhatTheirEncodingLacks)
{
    const std::u16string units = {u'a', 0xD800, 0, 0xE9};
    const CFOwner owner(CFStringCreateWithCharacters(nullptr, units.data(), static_cast<CFIndex>(units.size())));
    const auto* text = static_cast<CFStringRef>(owner.get());
    EXPECT_EQ(MACtoZEB(text), units);
    std::array<char, 16> buffer = {};
    EXPECT_FALSE(CFStringGetCString(text, buffer.data(), buffer.size(), kCFStringEncodingASCII));
    EXPECT_EQ(CFStringCreateWithCString(nullptr, "\xC3", kCFStringEncodingUTF8), nullptr);
    EXPECT_EQ(CFStringCreateWithCString(nullptr, "\xE9", kCFStringEncodingASCII), nullptr);

    const CFOwner accent(MakeString("h\xC3\xA9"));
    const auto* word = static_cast<CFStringRef>(accent.get());
    EXPECT_EQ(CFStringGetLength(word), 2);
    EXPECT_FALSE(CFStringGetCString(word, buffer.data(), 3, kCFStringEncodingUTF8)) << "no room for the zero";
    ASSERT_TRUE(CFStringGetCString(word, buffer.data(), 4, kCFStringEncodingUTF8));
    EXPECT_STREQ(buffer.data(), "h\xC3\xA9");
    ASSERT_TRUE(CFStringGetCString(word, buffer.data(), 4, kCFStringEncodingISOLatin1));
    EXPECT_STREQ(buffer.data(), "h\xE9");
    EXPECT_EQ(CFSTR("once"), CFSTR("once"));
}

TEST(CFObjects, StreamsAreReadAndWrittenOnlyWhileOpen)
{
    static constexpr UInt8 kBytes[] = {1, 2, 3};
    CFReadStreamRef in = CFReadStreamCreateWithBytesNoCopy(nullptr, kBytes, 3, kCFAllocatorNull);
    const CFOwner inOwner(in);
    std::array<UInt8, 4> buffer = {};
    EXPECT_EQ(CFReadStreamRead(in, buffer.data(), 2), -1);
    EXPECT_TRUE(CFReadStreamOpen(in));
    EXPECT_FALSE(CFReadStreamOpen(in));
    EXPECT_EQ(CFReadStreamRead(in, buffer.data(), 2), 2);
    EXPECT_EQ(CFReadStreamRead(in, buffer.data(), 4), 1);
    EXPECT_EQ(buffer[0], 3);
    EXPECT_EQ(CFReadStreamGetStatus(in), kCFStreamStatusAtEnd);
    EXPECT_EQ(CFReadStreamRead(in, buffer.data(), 4), 0);
    CFReadStreamClose(in);
    EXPECT_EQ(CFReadStreamRead(in, buffer.data(), 4), -1);

    CFWriteStreamRef out = CFWriteStreamCreateWithAllocatedBuffers(nullptr, nullptr);
    const CFOwner outOwner(out);
    EXPECT_EQ(CFWriteStreamWrite(out, kBytes, 3), -1);
    EXPECT_TRUE(CFWriteStreamOpen(out));
    EXPECT_EQ(CFWriteStreamWrite(out, kBytes, 3), 3);
    EXPECT_EQ(CFWriteStreamWrite(out, kBytes, 2), 2);
    CFWriteStreamClose(out);
    EXPECT_EQ(CFWriteStreamWrite(out, kBytes, 3), -1);
    const CFOwner written(CFWriteStreamCopyProperty(out, kCFStreamPropertyDataWritten));
    EXPECT_EQ(ToText(static_cast<CFDataRef>(written.get())), std::string("\1\2\3\1\2"));
    EXPECT_EQ(CFWriteStreamCopyProperty(out, CFSTR("other")), nullptr);
}

TEST(CFObjects, LocationsOfFilesKeepTheirBytes)
{
    const std::string path = "/a b/\xFF.component";
    const CFOwner owner(CFURLCreateFromFileSystemRepresentation(nullptr, reinterpret_cast<const UInt8*>(path.data()),
                                                                static_cast<CFIndex>(path.size()), 1));
    std::array<UInt8, 64> buffer = {};
    const auto* url = static_cast<CFURLRef>(owner.get());
    ASSERT_TRUE(CFURLGetFileSystemRepresentation(url, 1, buffer.data(), buffer.size()));
    EXPECT_EQ(std::memcmp(buffer.data(), path.c_str(), path.size() + 1), 0);
    EXPECT_FALSE(CFURLGetFileSystemRepresentation(url, 1, buffer.data(), static_cast<CFIndex>(path.size())));
}

} // namespace
} // namespace zebaudiofilterhost::xau
