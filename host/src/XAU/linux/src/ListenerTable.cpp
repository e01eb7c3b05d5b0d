#include "host/src/XAU/linux/src/ListenerTable.h"

#include "host/src/XAU/linux/src/AUListener.h"

#include <boost/container_hash/hash.hpp>

#include <algorithm>
#include <bit>
#include <utility>

namespace zebaudiofilterhost::xau
{

namespace
{

constexpr std::size_t kFirstCapacity = 16;

} // namespace

bool IsSameEvent(const AudioUnitEvent& a, const AudioUnitEvent& b)
{
    // Both records name their thing by the same four numbers.
    const AudioUnitParameter& one = a.mArgument.mParameter;
    const AudioUnitParameter& other = b.mArgument.mParameter;
    return a.mEventType == b.mEventType && one.mAudioUnit == other.mAudioUnit &&
           one.mParameterID == other.mParameterID && one.mScope == other.mScope && one.mElement == other.mElement;
}

ListenerTable::Cells::Cells(std::size_t capacity) : mCells(capacity), mBuckets(capacity)
{
}

std::size_t ListenerTable::Cells::BucketOf(const AudioUnitEvent& event) const
{
    const AudioUnitParameter& thing = event.mArgument.mParameter;
    std::size_t hash = event.mEventType;
    boost::hash_combine(hash, thing.mParameterID);
    boost::hash_combine(hash, thing.mScope);
    boost::hash_combine(hash, thing.mElement);
    return hash & (mBuckets.size() - 1);
}

void ListenerTable::Cells::Append(ListenerRow& row)
{
    const std::size_t index = mCount.load(std::memory_order_relaxed);
    const auto place = static_cast<std::uint32_t>(index + 1);
    mCells[index].mRow.store(&row, std::memory_order_release);
    Bucket& bucket = mBuckets[BucketOf(row.mEvent)];
    const std::uint32_t last = std::exchange(bucket.mLast, place);
    std::atomic<std::uint32_t>& leading = last == kNoPlace ? bucket.mFirst : mCells[last - 1].mNext;
    leading.store(place, std::memory_order_release);
    mCount.store(index + 1, std::memory_order_release);
}

void ListenerTable::Cells::Remove(const ListenerRow& row)
{
    std::uint32_t place = mBuckets[BucketOf(row.mEvent)].mFirst.load(std::memory_order_relaxed);
    for (; place != kNoPlace; place = mCells[place - 1].mNext.load(std::memory_order_relaxed))
    {
        if (mCells[place - 1].mRow.load(std::memory_order_relaxed) == &row)
            mCells[place - 1].mRow.store(nullptr, std::memory_order_seq_cst); // before the question for readers
    }
}

ListenerTable::ListenerTable()
{
    mCells.Publish(std::make_shared<Cells>(kFirstCapacity));
}

void ListenerTable::Append(ListenerRow& row)
{
    const std::lock_guard lock(mChanging);
    if (GetCells().mCount.load(std::memory_order_relaxed) == GetCells().mCells.size())
        Replace();
    GetCells().Append(row);
}

void ListenerTable::Remove(std::span<ListenerRow* const> rows)
{
    const std::lock_guard lock(mChanging);
    for (const ListenerRow* row : rows)
        GetCells().Remove(*row);
    mCells.AwaitReaders();
}

void ListenerTable::Close()
{
    const std::lock_guard lock(mChanging);
    std::vector<AUListenerBase*> listeners;
    listeners.reserve(GetCells().mCount.load(std::memory_order_relaxed));
    mIsClosed.store(true, std::memory_order_seq_cst);
    for (Cell& cell : GetCells().mCells)
    {
        if (const ListenerRow* row = cell.mRow.exchange(nullptr, std::memory_order_seq_cst))
            listeners.push_back(row->mListener);
    }
    mCells.AwaitReaders();
    // They are there: as long as nothing says that the table is emptied they keep its rows, and who has rows of it
    // waits for the lock before it goes.
    for (AUListenerBase* listener : listeners)
        listener->LoseUnit();
    mIsEmptied.store(true, std::memory_order_release);
}

// By room for as many rows again as there are; cells of rows that have gone are left out.
void ListenerTable::Replace()
{
    std::vector<ListenerRow*> rows;
    ForEach([&rows](ListenerRow& row) { rows.push_back(&row); });
    auto cells = std::make_shared<Cells>(std::bit_ceil(std::max(kFirstCapacity, 2 * rows.size())));
    for (ListenerRow* row : rows)
        cells->Append(*row);
    mCells.Publish(std::move(cells));
    mCells.AwaitReaders();
    mCells.FreeRetired();
}

} // namespace zebaudiofilterhost::xau
