#pragma once

#include "CoreFoundation/CFBase.h"

// Property lists: strings, numbers, Booleans, dates, data, arrays, and dictionaries by string. A string is written up
// to a zero in it, and bytes with one in a string are no property list here. Dates are kept to the second.

enum CFPropertyListFormat : CFIndex
{
    kCFPropertyListOpenStepFormat = 1, // not supported
    kCFPropertyListXMLFormat_v1_0 = 100,
    kCFPropertyListBinaryFormat_v1_0 = 200
};

enum CFPropertyListMutabilityOptions : CFOptionFlags
{
    kCFPropertyListImmutable = 0,
    kCFPropertyListMutableContainers = 1
};

/// Null if the bytes are no property list. `format` may be null. `error`, if given, becomes null.
CF_EXPORT CFPropertyListRef CFPropertyListCreateWithData(CFAllocatorRef allocator, CFDataRef data,
                                                         CFOptionFlags options, CFPropertyListFormat* format,
                                                         CFErrorRef* error);
/// Reads `count` bytes, or with 0 to the stream's end. The stream must be open.
CF_EXPORT CFPropertyListRef CFPropertyListCreateWithStream(CFAllocatorRef allocator, CFReadStreamRef stream,
                                                           CFIndex count, CFOptionFlags options,
                                                           CFPropertyListFormat* format, CFErrorRef* error);
/// Null if something in it is no part of a property list.
CF_EXPORT CFDataRef CFPropertyListCreateData(CFAllocatorRef allocator, CFPropertyListRef list,
                                             CFPropertyListFormat format, CFOptionFlags options, CFErrorRef* error);
/// Bytes written; 0 on failure. The stream must be open.
CF_EXPORT CFIndex CFPropertyListWrite(CFPropertyListRef list, CFWriteStreamRef stream, CFPropertyListFormat format,
                                      CFOptionFlags options, CFErrorRef* error);
