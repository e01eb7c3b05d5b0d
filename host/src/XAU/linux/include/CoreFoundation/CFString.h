#pragma once

#include "CoreFoundation/CFBase.h"

// Text of 16-bit units.

using CFStringEncoding = UInt32;

enum CFStringBuiltInEncodings : CFStringEncoding
{
    kCFStringEncodingMacRoman = 0, // of which only ASCII is known here
    kCFStringEncodingUTF16 = 0x0100,
    kCFStringEncodingUnicode = kCFStringEncodingUTF16,
    kCFStringEncodingISOLatin1 = 0x0201,
    kCFStringEncodingASCII = 0x0600,
    kCFStringEncodingUTF8 = 0x08000100
};

enum CFStringCompareFlags : CFOptionFlags
{
    kCFCompareCaseInsensitive = 1 // of ASCII letters
};

CF_EXPORT CFTypeID CFStringGetTypeID();

/// Null for bytes that the encoding does not allow, and for an encoding that is not named above.
CF_EXPORT CFStringRef CFStringCreateWithBytes(CFAllocatorRef allocator, const UInt8* bytes, CFIndex count,
                                              CFStringEncoding encoding, Boolean isExternalRepresentation);
CF_EXPORT CFStringRef CFStringCreateWithCString(CFAllocatorRef allocator, const char* text,
                                                CFStringEncoding encoding);
CF_EXPORT CFStringRef CFStringCreateWithCharacters(CFAllocatorRef allocator, const UniChar* units, CFIndex count);
CF_EXPORT CFStringRef CFStringCreateCopy(CFAllocatorRef allocator, CFStringRef text);
CF_EXPORT CFStringRef CFStringCreateWithSubstring(CFAllocatorRef allocator, CFStringRef text, CFRange range);

CF_EXPORT CFIndex CFStringGetLength(CFStringRef text);
CF_EXPORT UniChar CFStringGetCharacterAtIndex(CFStringRef text, CFIndex index);
/// The range must lie within the text.
CF_EXPORT void CFStringGetCharacters(CFStringRef text, CFRange range, UniChar* buffer);
/// False if the buffer, of `size` bytes, is too small for the text and its zero, or if the encoding lacks a
/// character.
CF_EXPORT Boolean CFStringGetCString(CFStringRef text, char* buffer, CFIndex size, CFStringEncoding encoding);
/// Bytes that suffice for so many units, without a zero.
CF_EXPORT CFIndex CFStringGetMaximumSizeForEncoding(CFIndex length, CFStringEncoding encoding);
CF_EXPORT CFComparisonResult CFStringCompare(CFStringRef a, CFStringRef b, CFOptionFlags flags);

/// One object for each text, which is ASCII; it lives to the end of the process. Through CFSTR.
CF_EXPORT CFStringRef CFStringMakeConstantString(const char* text);
#define CFSTR(text) CFStringMakeConstantString(text)
