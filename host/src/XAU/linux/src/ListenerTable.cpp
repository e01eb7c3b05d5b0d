#include "host/src/XAU/linux/src/ListenerTable.h"

#include <memory>
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

bool Interest::operator==(const Interest& other) const
{
    return mObject == other.mObject && IsSameEvent(mEvent, other.mEvent);
}

ListenerTable::ListenerTable()
{
    mRows.Publish(std::make_shared<Rows>(kFirstCapacity));
}

void ListenerTable::Append(AUListenerBase* listener, const Interest& interest)
{
    const std::lock_guard lock(mChanging);
    const std::size_t count = GetRows().mCount.load(std::memory_order_relaxed);
    if (count == GetRows().mRows.size())
        Replace(2 * count, [](const Row&) { return false; });
    Rows& rows = GetRows();
    rows.mRows[count] = {listener, interest};
    rows.mCount.store(count + 1, std::memory_order_release);
}

void ListenerTable::Remove(const std::function<bool(const Row&)>& isOut)
{
    const std::lock_guard lock(mChanging);
    Replace(GetRows().mRows.size(), isOut);
}

void ListenerTable::Replace(std::size_t capacity, const std::function<bool(const Row&)>& isOut)
{
    auto rows = std::make_shared<Rows>(capacity);
    const Rows& from = GetRows();
    std::size_t count = 0;
    for (std::size_t index = 0; index < from.mCount.load(std::memory_order_relaxed); ++index)
    {
        if (!isOut(from.mRows[index]))
            rows->mRows[count++] = from.mRows[index];
    }
    rows->mCount.store(count, std::memory_order_relaxed); // publishing comes behind it
    mRows.Publish(std::move(rows));
    mRows.AwaitReaders();
    mRows.FreeRetired();
}

} // namespace zebaudiofilterhost::xau
