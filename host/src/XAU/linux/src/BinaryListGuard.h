#pragma once

#include "CoreFoundation/CFBase.h"

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

namespace zebaudiofilterhost::xau::cf
{

/// Looks at the objects of a list in binary form before the parser does.
class BinaryListGuard
{
public:
    using Bytes = std::span<const UInt8>;

    static bool IsBinary(Bytes bytes);

    /// `bytes` are borrowed, and binary.
    explicit BinaryListGuard(Bytes bytes);

    /// False for a zero in a text, for too many nodes, too deep ones, and those that hold themselves.
    bool IsSafe();

private:
    // What the list has below an object, with the object, copied out at every reference.
    struct Extent
    {
        std::size_t mNodes = 1;
        std::size_t mBytes = 0;
        int mHeight = 0;
        bool mIsOpen = true; // on the way from the root
    };

    struct Place
    {
        UInt64 mAt;
        UInt64 mCount;
    };

    std::optional<UInt64> FindObject(UInt64 index) const;
    std::optional<Place> FindContent(UInt64 marker) const;
    bool IsSafeContent(const Place& content, unsigned int kind) const;
    bool Measure(UInt64 index, int depth);
    bool MeasureContent(UInt64 index, UInt64 marker, int depth);
    bool MeasureItems(UInt64 index, const Place& references, int depth);

    Bytes mBytes;
    std::size_t mMostBytes; // at all places of the objects
    std::size_t mOffsetSize;
    std::size_t mReferenceSize;
    UInt64 mCount; // objects, as many as there is room for
    UInt64 mRoot;
    UInt64 mTable;
    // Seen; objects that share their bytes must not make the look itself long.
    std::size_t mReferences = 0;
    std::size_t mContentSize = 0;
    std::vector<std::optional<Extent>> mExtents;
};

} // namespace zebaudiofilterhost::xau::cf
