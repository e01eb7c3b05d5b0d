#include "host/src/VST3/src/ParameterChangeTable.h"

#include <bit>
#include <utility>

namespace zebaudiofilterhost::vst3
{

ParameterChangeTable::ParameterChangeTable(std::vector<Steinberg::Vst::ParamID> ids)
    : mIDs(std::move(ids))
    , mBuckets(std::bit_ceil(2 * mIDs.size() + 2), static_cast<std::uint32_t>(mIDs.size()))
    , mRings(mIDs.size())
    , mDirty(mIDs.size())
{
    for (std::uint32_t position = 0; position < mIDs.size(); ++position)
    {
        std::size_t bucket = BucketOf(mIDs[position]);
        while (mBuckets[bucket] != mIDs.size())
            bucket = Next(bucket);
        mBuckets[bucket] = position;
    }
}

std::size_t ParameterChangeTable::BucketOf(Steinberg::Vst::ParamID id) const
{
    // Multiplication by the golden ratio spreads IDs that count up in steps of any size; the upper half is the best.
    constexpr std::uint64_t kGoldenRatio = 0x9e3779b97f4a7c15;
    return static_cast<std::size_t>((id * kGoldenRatio) >> 32) & (mBuckets.size() - 1);
}

std::size_t ParameterChangeTable::Find(Steinberg::Vst::ParamID id) const
{
    for (std::size_t bucket = BucketOf(id);; bucket = Next(bucket))
    {
        const std::size_t position = mBuckets[bucket];
        if (position == mIDs.size() || mIDs[position] == id)
            return position;
    }
}

void ParameterChangeTable::Write(Steinberg::Vst::ParamID id, const ParameterQueueValue& value)
{
    const std::size_t position = Find(id);
    if (position == mIDs.size())
        return;
    // In this order: whoever finds the ring in the set finds the change in the ring.
    mRings[position].Write(value);
    mDirty.Add(position);
}

bool ParameterChangeTable::Read(Steinberg::Vst::ParamID id, ParameterQueueValue& value)
{
    const std::size_t position = Find(id);
    if (position == mIDs.size())
        return false;
    ParameterRing& ring = mRings[position];
    if (ring.Read(value, ring.GetEnd()))
        return true;
    if (!mDirty.MayHaveAny() || !ring.IsEmpty())
        return false;
    mDirty.Remove(position);
    // A change that came between the look and the removal has set its mark in vain.
    if (!ring.IsEmpty())
        mDirty.Add(position);
    return false;
}

void ParameterChangeTable::DiscardAll()
{
    for (ParameterRing& ring : mRings)
        ring.Discard();
}

void ParameterChangeTable::CopyTo(ParameterChangeTable& other) const
{
    for (std::size_t position = 0; position < mIDs.size(); ++position)
    {
        mRings[position].CopyTo(other.mRings[position]);
        if (!other.mRings[position].IsEmpty())
            other.mDirty.Add(position);
    }
}

} // namespace zebaudiofilterhost::vst3
