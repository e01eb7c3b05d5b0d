#pragma once

#include <cstddef>
#include <cstdint>

// The part of CoreFoundation that audio units and their host share on a system that has none: published names,
// numbers and meanings. These headers want C++17; the interface of the binaries is C's. Objects are counted: a CF
// function with "Create" or "Copy" in its name hands out a reference that the caller releases, one with "Get" does
// not. (Units have a custom of their own: see AudioUnitGetProperty.) A null allocator is the default one; objects
// ignore which one they are given. Objects that cannot change may be used from any thread, the others from one at a
// time. [any]
//
// Who calls what, here and in the headers of units: [main] is the thread that the host makes its units on, [process]
// the one that renders, [any] one of these or another, several at once.
#define CF_EXPORT extern "C" __attribute__((visibility("default")))

using Boolean = unsigned char;
using SInt8 = std::int8_t;
using UInt8 = std::uint8_t;
using SInt16 = std::int16_t;
using UInt16 = std::uint16_t;
using SInt32 = std::int32_t;
using UInt32 = std::uint32_t;
using SInt64 = std::int64_t;
using UInt64 = std::uint64_t;
using Float32 = float;
using Float64 = double;
using UniChar = char16_t;
using OSStatus = SInt32;
using OSType = UInt32;

using CFTypeRef = const void*;
using CFTypeID = unsigned long;
using CFHashCode = unsigned long;
using CFOptionFlags = unsigned long;
using CFIndex = long;
using CFTimeInterval = double; // seconds
using CFAbsoluteTime = double; // seconds since 2001-01-01T00:00:00Z

using CFAllocatorRef = const struct CFOpaqueAllocator*;
using CFStringRef = const struct CFOpaqueString*;
using CFNumberRef = const struct CFOpaqueNumber*;
using CFBooleanRef = const struct CFOpaqueBoolean*;
using CFDateRef = const struct CFOpaqueDate*;
using CFDataRef = const struct CFOpaqueData*;
using CFMutableDataRef = struct CFOpaqueData*;
using CFArrayRef = const struct CFOpaqueArray*;
using CFMutableArrayRef = struct CFOpaqueArray*;
using CFDictionaryRef = const struct CFOpaqueDictionary*;
using CFMutableDictionaryRef = struct CFOpaqueDictionary*;
using CFURLRef = const struct CFOpaqueURL*;
using CFErrorRef = struct CFOpaqueError*; // never made: failure is told by the result alone
using CFReadStreamRef = struct CFOpaqueReadStream*;
using CFWriteStreamRef = struct CFOpaqueWriteStream*;
using CFRunLoopRef = struct CFOpaqueRunLoop*;
using CFPropertyListRef = CFTypeRef; // a string, number, Boolean, date, data, array or dictionary

struct CFRange
{
    CFIndex location;
    CFIndex length;
};

inline CFRange CFRangeMake(CFIndex location, CFIndex length)
{
    return {location, length};
}

enum CFComparisonResult : CFIndex
{
    kCFCompareLessThan = -1,
    kCFCompareEqualTo = 0,
    kCFCompareGreaterThan = 1
};

inline constexpr CFIndex kCFNotFound = -1;

CF_EXPORT const CFAllocatorRef kCFAllocatorDefault; // null
CF_EXPORT const CFAllocatorRef kCFAllocatorMalloc;
CF_EXPORT const CFAllocatorRef kCFAllocatorNull; // as a deallocator: the bytes stay the caller's

// None of these takes null.
CF_EXPORT CFTypeRef CFRetain(CFTypeRef object);
CF_EXPORT void CFRelease(CFTypeRef object);
CF_EXPORT CFIndex CFGetRetainCount(CFTypeRef object);
CF_EXPORT CFTypeID CFGetTypeID(CFTypeRef object);
CF_EXPORT Boolean CFEqual(CFTypeRef a, CFTypeRef b);
CF_EXPORT CFHashCode CFHash(CFTypeRef object);
