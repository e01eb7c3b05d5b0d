#include "CoreFoundation/CFStream.h"

#include "CoreFoundation/CFData.h"
#include "CoreFoundation/CFString.h"
#include "host/src/XAU/linux/src/CFStreamObject.h"

#include <algorithm>
#include <cstdlib>

using namespace zebaudiofilterhost::xau;

const CFStringRef kCFStreamPropertyDataWritten = CFSTR("kCFStreamPropertyDataWritten");

CFOpaqueReadStream::CFOpaqueReadStream(std::span<const UInt8> bytes, bool freesBytes)
    : Object(cf::TypeID::ReadStream), mBytes(bytes), mFreesBytes(freesBytes)
{
}

CFOpaqueReadStream::~CFOpaqueReadStream()
{
    if (mFreesBytes)
        std::free(const_cast<UInt8*>(mBytes.data())); // NOLINT(cppcoreguidelines-no-malloc): how the caller made it
}

std::span<const UInt8> CFOpaqueReadStream::Take(std::size_t count)
{
    const std::span<const UInt8> taken = mBytes.subspan(mPosition, std::min(count, mBytes.size() - mPosition));
    mPosition += taken.size();
    if (mPosition == mBytes.size())
        mStatus = kCFStreamStatusAtEnd;
    return taken;
}

CFReadStreamRef CFReadStreamCreateWithBytesNoCopy(CFAllocatorRef /*allocator*/, const UInt8* bytes, CFIndex count,
                                                  CFAllocatorRef bytesDeallocator)
{
    if (count < 0 || (!bytes && count > 0))
        return nullptr;
    return new CFOpaqueReadStream({bytes, static_cast<std::size_t>(count)}, bytesDeallocator != kCFAllocatorNull);
}

CFStreamStatus CFReadStreamGetStatus(CFReadStreamRef stream)
{
    return stream->mStatus;
}

Boolean CFReadStreamOpen(CFReadStreamRef stream)
{
    if (stream->mStatus != kCFStreamStatusNotOpen)
        return 0;
    stream->mStatus = kCFStreamStatusOpen;
    return 1;
}

void CFReadStreamClose(CFReadStreamRef stream)
{
    stream->mStatus = kCFStreamStatusClosed;
}

CFIndex CFReadStreamRead(CFReadStreamRef stream, UInt8* buffer, CFIndex size)
{
    if (!stream->IsReadable() || size < 0)
        return -1;
    const std::span<const UInt8> taken = stream->Take(static_cast<std::size_t>(size));
    std::copy(taken.begin(), taken.end(), buffer);
    return static_cast<CFIndex>(taken.size());
}

CFWriteStreamRef CFWriteStreamCreateWithAllocatedBuffers(CFAllocatorRef /*allocator*/,
                                                         CFAllocatorRef /*bufferAllocator*/)
{
    return new CFOpaqueWriteStream();
}

CFStreamStatus CFWriteStreamGetStatus(CFWriteStreamRef stream)
{
    return stream->mStatus;
}

Boolean CFWriteStreamOpen(CFWriteStreamRef stream)
{
    if (stream->mStatus != kCFStreamStatusNotOpen)
        return 0;
    stream->mStatus = kCFStreamStatusOpen;
    return 1;
}

void CFWriteStreamClose(CFWriteStreamRef stream)
{
    stream->mStatus = kCFStreamStatusClosed;
}

CFIndex CFWriteStreamWrite(CFWriteStreamRef stream, const UInt8* bytes, CFIndex count)
{
    if (stream->mStatus != kCFStreamStatusOpen || count < 0)
        return -1;
    stream->mBytes.insert(stream->mBytes.end(), bytes, bytes + count);
    return count;
}

CFTypeRef CFWriteStreamCopyProperty(CFWriteStreamRef stream, CFStringRef name)
{
    if (CFEqual(name, kCFStreamPropertyDataWritten) == 0)
        return nullptr;
    return CFDataCreate(nullptr, stream->mBytes.data(), static_cast<CFIndex>(stream->mBytes.size()));
}
