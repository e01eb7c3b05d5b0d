#pragma once

#include "host/src/VST3/src/DirtySet.h"
#include "host/src/VST3/src/ParameterQueueValue.h"
#include "host/src/VST3/src/ParameterRing.h"

#include <pluginterfaces/vst/vsttypes.h>

#include <cstddef>
#include <cstdint>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// One ring for each of a fixed list of parameter IDs, and the set of those that were written. [any]
class ParameterChangeTable
{
public:
    /// Takes IDs in ascending order without repetitions.
    explicit ParameterChangeTable(std::vector<Steinberg::Vst::ParamID> ids);

    const std::vector<Steinberg::Vst::ParamID>& GetIDs() const { return mIDs; }

    /// Nothing happens for an unknown ID.
    void Write(Steinberg::Vst::ParamID id, const ParameterQueueValue& value);
    /// Takes the oldest change of this ID. False, with nothing written, when there is none.
    bool Read(Steinberg::Vst::ParamID id, ParameterQueueValue& value);
    /// False means that nothing is pending.
    bool MayHaveChanges() const { return mDirty.MayHaveAny(); }
    /// Calls `visit(id, change)` for what is pending, by ascending ID, and takes it out. One thread at a time.
    template <class Visit>
    void TakeAll(const Visit& visit)
    {
        mDirty.TakeAll(
            [&](std::size_t position)
            {
                ParameterRing& ring = mRings[position];
                const std::uint64_t end = ring.GetEnd();
                for (ParameterQueueValue value; ring.Read(value, end);)
                    visit(mIDs[position], value);
            });
    }

    void DiscardAll();
    /// `other` has the same IDs.
    void CopyTo(ParameterChangeTable& other) const;

private:
    /// The position of the ID, or the number of IDs.
    std::size_t Find(Steinberg::Vst::ParamID id) const;
    std::size_t BucketOf(Steinberg::Vst::ParamID id) const;
    std::size_t Next(std::size_t bucket) const { return (bucket + 1) & (mBuckets.size() - 1); }

    const std::vector<Steinberg::Vst::ParamID> mIDs;
    /// Open addressing, at most half full: positions in mIDs, and their number for a free bucket. A power of two of
    /// them. A look-up costs the same however many IDs there are.
    std::vector<std::uint32_t> mBuckets;
    std::vector<ParameterRing> mRings;
    DirtySet mDirty;
};

} // namespace zebaudiofilterhost::vst3
