#pragma once

#include "CoreFoundation/CFBase.h"

// Streams on memory.

enum CFStreamStatus : CFIndex
{
    kCFStreamStatusNotOpen = 0,
    kCFStreamStatusOpening = 1,
    kCFStreamStatusOpen = 2,
    kCFStreamStatusReading = 3,
    kCFStreamStatusWriting = 4,
    kCFStreamStatusAtEnd = 5,
    kCFStreamStatusClosed = 6,
    kCFStreamStatusError = 7
};

/// Property of a write stream: all that was written, as CFDataRef.
CF_EXPORT const CFStringRef kCFStreamPropertyDataWritten;

/// `bytesDeallocator` frees the bytes at the end: null or kCFAllocatorMalloc by free(), kCFAllocatorNull not at all.
CF_EXPORT CFReadStreamRef CFReadStreamCreateWithBytesNoCopy(CFAllocatorRef allocator, const UInt8* bytes,
                                                            CFIndex count, CFAllocatorRef bytesDeallocator);
CF_EXPORT CFStreamStatus CFReadStreamGetStatus(CFReadStreamRef stream);
/// False on a stream that was opened before.
CF_EXPORT Boolean CFReadStreamOpen(CFReadStreamRef stream);
CF_EXPORT void CFReadStreamClose(CFReadStreamRef stream);
/// Bytes read; 0 at the end, -1 on a stream that is not open.
CF_EXPORT CFIndex CFReadStreamRead(CFReadStreamRef stream, UInt8* buffer, CFIndex size);

CF_EXPORT CFWriteStreamRef CFWriteStreamCreateWithAllocatedBuffers(CFAllocatorRef allocator,
                                                                   CFAllocatorRef bufferAllocator);
CF_EXPORT CFStreamStatus CFWriteStreamGetStatus(CFWriteStreamRef stream);
CF_EXPORT Boolean CFWriteStreamOpen(CFWriteStreamRef stream);
CF_EXPORT void CFWriteStreamClose(CFWriteStreamRef stream);
/// Bytes written, -1 on a stream that is not open.
CF_EXPORT CFIndex CFWriteStreamWrite(CFWriteStreamRef stream, const UInt8* bytes, CFIndex count);
/// Null for a property that it does not have.
CF_EXPORT CFTypeRef CFWriteStreamCopyProperty(CFWriteStreamRef stream, CFStringRef name);
