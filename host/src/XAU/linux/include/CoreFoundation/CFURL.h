#pragma once

#include "CoreFoundation/CFBase.h"

// Locations of files. There is no other kind here.

CF_EXPORT CFTypeID CFURLGetTypeID();
/// Null for no bytes. The path is the system's, in its own bytes.
CF_EXPORT CFURLRef CFURLCreateFromFileSystemRepresentation(CFAllocatorRef allocator, const UInt8* path, CFIndex count,
                                                           Boolean isDirectory);
/// False if the path and its zero do not fit into `size` bytes. A relative path is made absolute on demand.
CF_EXPORT Boolean CFURLGetFileSystemRepresentation(CFURLRef url, Boolean resolveAgainstBase, UInt8* path,
                                                   CFIndex size);
