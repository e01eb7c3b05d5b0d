#include "host/src/VST3/src/VST3MemoryStream.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <new>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::int64;
using Steinberg::tresult;
using Steinberg::uint32;

namespace
{

// Positions come from plug-ins, so that their sum can leave the range of the type.
int64 SaturatedSum(int64 left, int64 right)
{
    if (right > 0 && left > std::numeric_limits<int64>::max() - right)
        return std::numeric_limits<int64>::max();
    if (right < 0 && left < std::numeric_limits<int64>::min() - right)
        return std::numeric_limits<int64>::min();
    return left + right;
}

} // namespace

int64 VST3MemoryStream::GetSize() const
{
    return static_cast<int64>(mBorrowed.empty() ? mData.size() : mBorrowed.size());
}

const char* VST3MemoryStream::GetData() const
{
    return mBorrowed.empty() ? mData.data() : mBorrowed.data();
}

void VST3MemoryStream::Borrow(std::span<const char> bytes)
{
    mData.clear();
    mBorrowed = bytes;
    mPosition = 0;
}

void VST3MemoryStream::TakeOver()
{
    if (mBorrowed.empty())
        return;
    mData.assign(mBorrowed.begin(), mBorrowed.end());
    mBorrowed = {};
}

bool VST3MemoryStream::SetSize(int64 size)
{
    if (size > kMaxSize)
        return false;
    const auto end = static_cast<std::size_t>(std::max<int64>(size, 0));
    try
    {
        TakeOver();
        if (end > mData.size() && mData.capacity() < 2 * end)
            mData.reserve(2 * end);
        mData.resize(end);
    }
    catch (const std::bad_alloc&)
    {
        return false;
    }
    return true;
}

tresult PLUGIN_API VST3MemoryStream::queryInterface(const Steinberg::TUID interfaceID, void** object)
{
    return QueryHostObject<Steinberg::IBStream>(*this, interfaceID, object);
}

uint32 PLUGIN_API VST3MemoryStream::addRef()
{
    return mReferenceCount.Add();
}

uint32 PLUGIN_API VST3MemoryStream::release()
{
    return mReferenceCount.Remove();
}

tresult PLUGIN_API VST3MemoryStream::read(void* buffer, int32 count, int32* numRead)
{
    if (numRead)
        *numRead = 0;
    if (SaturatedSum(mPosition, count) > GetSize())
    {
        count = static_cast<int32>(std::clamp<int64>(GetSize() - mPosition, 0, count < 0 ? 0 : count));
        if (count == 0)
            mPosition = GetSize();
    }
    // There is nothing to read before the first byte.
    if (count <= 0 || mPosition < 0 || !buffer)
        return Steinberg::kResultOk;
    std::memcpy(buffer, GetData() + mPosition, static_cast<std::size_t>(count));
    mPosition += count;
    if (numRead)
        *numRead = count;
    return Steinberg::kResultOk;
}

tresult PLUGIN_API VST3MemoryStream::write(void* buffer, int32 count, int32* numWritten)
{
    if (!buffer)
        return Steinberg::kInvalidArgument;
    if (numWritten)
        *numWritten = 0;
    if (mPosition < 0)
        return Steinberg::kInvalidArgument;
    if (!SetSize(SaturatedSum(mPosition, count)))
        return Steinberg::kOutOfMemory;
    if (count <= 0)
        return Steinberg::kResultOk;
    std::memcpy(mData.data() + mPosition, buffer, static_cast<std::size_t>(count));
    mPosition += count;
    if (numWritten)
        *numWritten = count;
    return Steinberg::kResultOk;
}

tresult PLUGIN_API VST3MemoryStream::seek(int64 offset, int32 mode, int64* result)
{
    switch (mode)
    {
    case kIBSeekSet:
        mPosition = offset;
        break;
    case kIBSeekCur:
        mPosition = SaturatedSum(mPosition, offset);
        break;
    case kIBSeekEnd:
        mPosition = SaturatedSum(GetSize(), offset);
        break;
    default:
        break;
    }
    if (result)
        *result = mPosition;
    return Steinberg::kResultOk;
}

tresult PLUGIN_API VST3MemoryStream::tell(int64* position)
{
    if (!position)
        return Steinberg::kInvalidArgument;
    *position = mPosition;
    return Steinberg::kResultOk;
}

} // namespace zebaudiofilterhost::vst3
