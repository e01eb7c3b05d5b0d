#include "host/src/XAU/linux/src/ListenerTable.h"

#include <memory>
#include <thread>

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

bool Interest::operator==(const Interest& other) const
{
    return mObject == other.mObject && IsSameEvent(mEvent, other.mEvent);
}

ListenerTable::ListenerTable() : mRows(new Rows(kFirstCapacity))
{
}

ListenerTable::~ListenerTable()
{
    const std::unique_ptr<const Rows> rows(mRows.load(std::memory_order_acquire));
}

void ListenerTable::Append(AUListenerBase* listener, const Interest& interest)
{
    const std::lock_guard lock(mChanging);
    const std::size_t count = mRows.load(std::memory_order_relaxed)->mCount.load(std::memory_order_relaxed);
    if (count == mRows.load(std::memory_order_relaxed)->mRows.size())
        Replace(2 * count, [](const Row&) { return false; });
    Rows& rows = *mRows.load(std::memory_order_relaxed); // only this side, under the lock, replaces or adds
    rows.mRows[count] = {listener, interest};
    rows.mCount.store(count + 1, std::memory_order_release);
}

void ListenerTable::Remove(const std::function<bool(const Row&)>& isOut)
{
    const std::lock_guard lock(mChanging);
    Replace(mRows.load(std::memory_order_relaxed)->mRows.size(), isOut);
}

void ListenerTable::Replace(std::size_t capacity, const std::function<bool(const Row&)>& isOut)
{
    auto rows = std::make_unique<Rows>(capacity);
    const Rows& from = *mRows.load(std::memory_order_relaxed);
    std::size_t count = 0;
    for (std::size_t index = 0; index < from.mCount.load(std::memory_order_relaxed); ++index)
    {
        if (!isOut(from.mRows[index]))
            rows->mRows[count++] = from.mRows[index];
    }
    rows->mCount.store(count, std::memory_order_relaxed); // the exchange below publishes it
    const std::unique_ptr<const Rows> old(mRows.exchange(rows.release(), std::memory_order_seq_cst));
    while (mReaders.load(std::memory_order_seq_cst) != 0)
        std::this_thread::yield();
}

} // namespace zebaudiofilterhost::xau
