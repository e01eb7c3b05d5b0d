#pragma once

#include "CoreFoundation/CFBase.h"

// Bytes.

CF_EXPORT CFTypeID CFDataGetTypeID();
CF_EXPORT CFDataRef CFDataCreate(CFAllocatorRef allocator, const UInt8* bytes, CFIndex count);
/// `capacity` is a limit only where it is not 0, and counts for nothing here.
CF_EXPORT CFMutableDataRef CFDataCreateMutable(CFAllocatorRef allocator, CFIndex capacity);
CF_EXPORT CFIndex CFDataGetLength(CFDataRef data);
/// Valid until the data changes or goes.
CF_EXPORT const UInt8* CFDataGetBytePtr(CFDataRef data);
CF_EXPORT void CFDataGetBytes(CFDataRef data, CFRange range, UInt8* buffer);
CF_EXPORT void CFDataAppendBytes(CFMutableDataRef data, const UInt8* bytes, CFIndex count);
