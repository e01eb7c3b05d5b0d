#pragma once

#include "utility/CommonTypes.h"

#include <CoreFoundation/CoreFoundation.h>

#include <memory>

namespace zebaudiofilterhost::xau
{

struct CFReleaser
{
    void operator()(CFTypeRef object) const { CFRelease(object); }
};

/// One reference on an object of the system's, released at the end.
using CFOwner = std::unique_ptr<const void, CFReleaser>;

/// The text; empty for null. The string stays the caller's. [any]
UTF16String MACtoZEB(CFStringRef text);

} // namespace zebaudiofilterhost::xau
