#pragma once

#include "CoreFoundation/CFBase.h"

namespace zebaudiofilterhost::xau::cf
{

// For containers of objects.

inline const void* RetainValue(CFAllocatorRef /*allocator*/, const void* value)
{
    return CFRetain(value);
}

inline void ReleaseValue(CFAllocatorRef /*allocator*/, const void* value)
{
    CFRelease(value);
}

} // namespace zebaudiofilterhost::xau::cf
