#include "host/src/XAU/linux/src/BinaryListGuard.h"

#include "host/src/XAU/linux/src/PropertyListGuard.h"
#include "host/src/XAU/linux/src/PropertyListNodes.h"

#include <algorithm>
#include <string_view>

namespace zebaudiofilterhost::xau::cf
{

namespace
{

constexpr std::string_view kMagic = "bplist";

// The end of the file says where the table of the objects' offsets is.
constexpr std::size_t kTrailerSize = 32;
constexpr std::size_t kOffsetSizeAt = 6;
constexpr std::size_t kReferenceSizeAt = 7;
constexpr std::size_t kObjectCountAt = 8;
constexpr std::size_t kRootAt = 16;
constexpr std::size_t kTableOffsetAt = 24;

// Kinds of objects.
constexpr unsigned int kData = 4;
constexpr unsigned int kWideText = 6;
constexpr unsigned int kArray = 10;
constexpr unsigned int kDictionary = 13;
constexpr unsigned int kLongCount = 15; // a number with the count follows the marker

constexpr unsigned int kHalfByte = 4;
constexpr unsigned int kByte = 8;

// Nothing if the bytes end before.
std::optional<UInt64> ReadNumber(BinaryListGuard::Bytes bytes, UInt64 at, std::size_t size)
{
    if (size > sizeof(UInt64) || bytes.size() < size || at > bytes.size() - size)
        return std::nullopt;
    UInt64 number = 0;
    for (const UInt8 byte : bytes.subspan(at, size))
        number = (number << kByte) | byte;
    return number;
}

} // namespace

bool BinaryListGuard::IsBinary(Bytes bytes)
{
    return bytes.size() >= kMagic.size() + kTrailerSize && std::equal(kMagic.begin(), kMagic.end(), bytes.begin());
}

BinaryListGuard::BinaryListGuard(Bytes bytes)
    : mBytes(bytes)
    , mMostBytes(std::max(kMaxPropertyListSize, bytes.size() * kMaxPropertyListCopies))
    , mOffsetSize(bytes.last(kTrailerSize)[kOffsetSizeAt])
    , mReferenceSize(bytes.last(kTrailerSize)[kReferenceSizeAt])
    , mCount(ReadNumber(bytes.last(kTrailerSize), kObjectCountAt, sizeof(UInt64)).value_or(0))
    , mRoot(ReadNumber(bytes.last(kTrailerSize), kRootAt, sizeof(UInt64)).value_or(0))
    , mTable(ReadNumber(bytes.last(kTrailerSize), kTableOffsetAt, sizeof(UInt64)).value_or(0))
{
    const UInt64 room = mOffsetSize == 0 || mTable > bytes.size() ? 0 : (bytes.size() - mTable) / mOffsetSize;
    mCount = std::min(mCount, room);
}

bool BinaryListGuard::IsSafe()
{
    if (mReferenceSize == 0 || mCount > kMaxPropertyListNodes)
        return false;
    mExtents.assign(mCount, std::nullopt);
    return Measure(mRoot, 0);
}

// Where its marker is.
std::optional<UInt64> BinaryListGuard::FindObject(UInt64 index) const
{
    if (index >= mCount)
        return std::nullopt;
    const auto offset = ReadNumber(mBytes, mTable + index * mOffsetSize, mOffsetSize);
    return offset && *offset < mBytes.size() ? offset : std::nullopt;
}

// Behind the marker and the count.
std::optional<BinaryListGuard::Place> BinaryListGuard::FindContent(UInt64 marker) const
{
    const unsigned int count = mBytes[marker] & kLongCount;
    if (count != kLongCount)
        return Place{marker + 1, count};
    const auto numberMarker = ReadNumber(mBytes, marker + 1, 1);
    if (!numberMarker)
        return std::nullopt;
    const std::size_t size = std::size_t{1} << (*numberMarker & kLongCount);
    const auto longCount = ReadNumber(mBytes, marker + 2, size);
    return longCount ? std::optional(Place{marker + 2 + size, *longCount}) : std::nullopt;
}

// Whether it lies within the bytes, and has a zero nowhere if it is a text.
bool BinaryListGuard::IsSafeContent(const Place& content, unsigned int kind) const
{
    const std::size_t size = kind == kWideText ? 2 : 1;
    if (content.mAt > mBytes.size() || content.mCount > (mBytes.size() - content.mAt) / size)
        return false;
    for (UInt64 index = 0; kind != kData && index < content.mCount; ++index)
    {
        if (ReadNumber(mBytes, content.mAt + index * size, size) == 0U)
            return false;
    }
    return true;
}

// Each object once: what is below it is the same at all its places.
bool BinaryListGuard::Measure(UInt64 index, int depth)
{
    const auto marker = FindObject(index);
    if (!marker || depth > kMaxPropertyListDepth)
        return false;
    if (const auto& known = mExtents[index])
        return !known->mIsOpen && depth + known->mHeight <= kMaxPropertyListDepth;
    mExtents[index].emplace();
    if (!MeasureContent(index, *marker, depth))
        return false;
    mExtents[index]->mIsOpen = false;
    return true;
}

bool BinaryListGuard::MeasureContent(UInt64 index, UInt64 marker, int depth)
{
    const unsigned int kind = mBytes[marker] >> kHalfByte;
    const bool isContainer = kind >= kArray && kind <= kDictionary;
    const bool hasBytes = kind >= kData && kind <= kWideText;
    if (!isContainer && !hasBytes)
        return true; // a number or the like
    const auto content = FindContent(marker);
    if (!content || content->mCount > mBytes.size())
        return false;
    if (isContainer) // a dictionary has its keys, then its values
        return MeasureItems(index, {content->mAt, content->mCount * (kind == kDictionary ? 2 : 1)}, depth);
    const std::size_t size = content->mCount * (kind == kWideText ? 2 : 1);
    mExtents[index]->mBytes = size;
    mContentSize += size;
    return mContentSize <= mMostBytes && IsSafeContent(*content, kind);
}

bool BinaryListGuard::MeasureItems(UInt64 index, const Place& references, int depth)
{
    mReferences += references.mCount;
    if (mReferences > kMaxPropertyListNodes)
        return false;
    Extent extent;
    for (UInt64 item = 0; item < references.mCount; ++item)
    {
        const auto target = ReadNumber(mBytes, references.mAt + item * mReferenceSize, mReferenceSize);
        if (!target || !Measure(*target, depth + 1))
            return false;
        const Extent& below = *mExtents[*target];
        extent.mNodes += below.mNodes;
        extent.mBytes += below.mBytes;
        extent.mHeight = std::max(extent.mHeight, below.mHeight + 1);
        if (extent.mNodes > kMaxPropertyListNodes || extent.mBytes > mMostBytes)
            return false;
    }
    mExtents[index] = extent;
    return true;
}

} // namespace zebaudiofilterhost::xau::cf
