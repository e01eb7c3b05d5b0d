#pragma once

#include "CoreFoundation/CFStream.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <cstddef>
#include <span>
#include <vector>

struct CFOpaqueReadStream final : zebaudiofilterhost::xau::cf::Object
{
    CFOpaqueReadStream(std::span<const UInt8> bytes, bool freesBytes);
    ~CFOpaqueReadStream() override;

    bool IsReadable() const { return mStatus == kCFStreamStatusOpen || mStatus == kCFStreamStatusAtEnd; }
    /// At most so many of what is left. The stream must be readable.
    std::span<const UInt8> Take(std::size_t count);

    CFStreamStatus mStatus = kCFStreamStatusNotOpen;

private:
    std::span<const UInt8> mBytes;
    std::size_t mPosition = 0;
    bool mFreesBytes;
};

struct CFOpaqueWriteStream final : zebaudiofilterhost::xau::cf::Object
{
    CFOpaqueWriteStream() : Object(zebaudiofilterhost::xau::cf::TypeID::WriteStream) {}

    CFStreamStatus mStatus = kCFStreamStatusNotOpen;
    std::vector<UInt8> mBytes;
};
