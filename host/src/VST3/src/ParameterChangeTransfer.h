#pragma once

#include "host/src/VST3/src/ParameterChangeTable.h"
#include "host/src/VST3/src/ParameterChanges.h"
#include "utility/src/Published.h"

#include <pluginterfaces/vst/vsttypes.h>

#include <atomic>
#include <memory>
#include <vector>

namespace zebaudiofilterhost::vst3
{

/// A mailbox of parameter changes between threads: for each known ID the newest kMaxPointsPerParameter changes. Any
/// number of threads may write while one reads and another gives it new IDs. One reads at a time, be it by
/// GetNextChange or by TransferChangesTo: what one of them is just looking at, the other would take for read. Nothing
/// here locks, and nothing allocates but SetParameterIDs and CopyTo.
///
/// How it holds together:
/// - The shape (which IDs there are) is a ParameterChangeTable, published as a whole and never changed after that. A
///   write into a replaced table is lost, as every pending change is when the shape changes.
/// - Each ID has a ParameterRing. A writer takes a ticket and writes words that carry the ticket, so that a value and
///   an offset of two writers never mix, and a writer that was held up cannot harm what came after it.
/// - A DirtySet knows which rings were written, so that a block costs what changes in it, whatever the number of
///   parameters.
class ParameterChangeTransfer
{
public:
    /// Knows no ID. [any]
    ParameterChangeTransfer();

    ParameterChangeTransfer(const ParameterChangeTransfer&) = delete;
    ParameterChangeTransfer& operator=(const ParameterChangeTransfer&) = delete;

    /// Repeated IDs count once. What was pending is dropped. Allocates. [any]
    void SetParameterIDs(const std::vector<Steinberg::Vst::ParamID>& ids);

    /// Frees what SetParameterIDs and CopyTo replaced, unless another thread is in here just now: then a later call
    /// does. [any but process]
    void FreeRetired();

    /// An unknown ID is ignored; a full ring loses its oldest change. [any]
    void AddChange(Steinberg::Vst::ParamID id, double value, Steinberg::int32 sampleOffset);

    /// False when nothing is pending; cheap however many IDs there are. Can be true once without reason. [any]
    bool HasChanges() const;

    /// Takes the oldest change of the ID out. False, with nothing written, when there is none. [any], one reader
    /// at a time
    bool GetNextChange(Steinberg::Vst::ParamID id, double& value, Steinberg::int32& sampleOffset);

    /// Moves what is pending, by ascending ID and oldest first. Changes of an ID behind one that another thread is
    /// just writing keep their order and come with a later call. True if something was moved. [process], or
    /// [main, suspended]; one reader at a time
    bool TransferChangesTo(ParameterChanges& changes)
    {
        return mWritten.load(std::memory_order_relaxed) && MoveAll(changes);
    }

    /// Reads all points; those of unknown IDs are lost. True if a point could be read. [process], or
    /// [main, suspended]
    bool TransferChangesFrom(ParameterChanges& changes) { return !changes.IsEmpty() && ReadAll(changes); }

    /// Drops what is pending. A change that is being read meanwhile can still be read. [any]
    void Discard();

    /// Gives `other` these IDs and a copy of what is pending here. Allocates. [any but process]
    void CopyTo(ParameterChangeTransfer& other) const;

private:
    using Table = Published<std::unique_ptr<ParameterChangeTable>>;

    void MarkWritten();
    bool MoveAll(ParameterChanges& changes);
    bool ReadAll(ParameterChanges& changes);

    Table mTable; // never holds null after construction

    /// False: nothing was written since TransferChangesTo looked last. Blocks without changes, which most are, look
    /// no further.
    std::atomic<bool> mWritten = false;
};

} // namespace zebaudiofilterhost::vst3
