#include "host/src/XAU/linux/src/AUListener.h"

#include "foundation/zebcore/HighPrecisionTime.h"

#include <algorithm>
#include <map>
#include <utility>

using namespace zebaudiofilterhost::xau;
using zebcore::utility::HighPrecisionTime;

namespace
{

constexpr std::chrono::milliseconds kShortestInterval(1);

RunLoopPtr Retain(CFRunLoopRef loop)
{
    CFRetain(loop);
    return RunLoopPtr(loop);
}

// 0 if the unit does not tell, or has gone.
AudioUnitParameterValue ReadValue(const ListenerRow& row)
{
    const AudioUnitParameter& parameter = row.mEvent.mArgument.mParameter;
    AudioUnitParameterValue value = 0.0F;
    row.mTable->WhileOpen(
        [&]
        {
            try
            {
                AudioUnitGetParameter(parameter.mAudioUnit, parameter.mParameterID, parameter.mScope,
                                      parameter.mElement, &value);
            }
            catch (...) // of the unit's: whoever hears of the change asks for the value, or takes this one
            {
            }
        });
    return value;
}

} // namespace

AUListenerBase::AUListenerBase(AUEventListenerProc proc, void* userData, CFRunLoopRef loop, Seconds interval,
                               Seconds granularity)
    : mProc(proc)
    , mUserData(userData)
    , mLoop(Retain(loop))
    , mGranularity(std::chrono::duration_cast<std::chrono::nanoseconds>(granularity))
    , mTimer(
          loop->AddTimer(std::max(kShortestInterval, std::chrono::duration_cast<std::chrono::milliseconds>(interval)),
                         [this] { Deliver(); }))
{
}

AUListenerBase::~AUListenerBase()
{
    mLoop->RemoveTimer(mTimer);
    *mIsAlive = false;
    std::map<TablePtr, std::vector<Row*>> rows;
    for (const RowPtr& row : mRows)
        rows[row->mTable].push_back(row.get());
    for (const auto& [table, ofTable] : rows)
        table->Remove(ofTable);
}

AUListenerBase::Row* AUListenerBase::Find(const AudioUnitEvent& event, const void* object,
                                          const TablePtr& table) const
{
    Row* found = nullptr;
    table->ForEach(event,
                   [&](Row& row)
                   {
                       if (row.mListener == this && row.mObject == object)
                           found = &row;
                   });
    return found;
}

void AUListenerBase::Add(const AudioUnitEvent& event, void* object, const TablePtr& table)
{
    if (Find(event, object, table))
        return;
    const RowPtr row = std::make_shared<Row>(this, event, object, table);
    mRows.insert(row);
    table->Append(*row);
}

void AUListenerBase::Remove(const AudioUnitEvent& event, void* object, const TablePtr& table)
{
    Row* const row = Find(event, object, table);
    if (!row)
        return;
    table->Remove({&row, 1});
    row->mIsWanted = false;
    mRemoved.push_back(row->shared_from_this());
    mRows.erase(mRemoved.back());
}

void AUListenerBase::Tell(Row& row, UInt64 hostTime, AudioUnitParameterValue value)
{
    const bool isValue = IsValueChange(row.mEvent);
    const UInt64 number = mNumber.fetch_add(1, std::memory_order_relaxed); // only to be compared
    if ((isValue ? mValues : mOthers).bounded_push({&row, number, hostTime, value}))
        return;
    row.mLastLeftOut.store(number, std::memory_order_relaxed);
    row.mLeftOut.fetch_add(1, std::memory_order_relaxed);
    MarkLeftOut();
}

void AUListenerBase::TellToRead(Row& row)
{
    row.mLastLeftOut.store(mNumber.fetch_add(1, std::memory_order_relaxed), std::memory_order_relaxed);
    row.mLeftOut.fetch_add(1, std::memory_order_relaxed);
    MarkLeftOut();
}

// With what the row says of it. An exchange, since a store would hide what another thread marked before: whoever
// takes the mark off must see the rows of both.
void AUListenerBase::MarkLeftOut()
{
    mHasLeftOut.exchange(true, std::memory_order_release);
}

std::vector<AUListenerBase::Heard> AUListenerBase::Collect()
{
    const std::vector<RowPtr> removed = std::exchange(mRemoved, {}); // until nothing of theirs waits any more
    if (mHasLostUnit.exchange(false, std::memory_order_acquire))
        DropLostUnits();
    std::vector<Heard> batch;
    const auto take = [&batch](const Told& told)
    {
        batch.push_back({told.mRow->shared_from_this(), told.mNumber, told.mHostTime, told.mValue, 1});
    };
    mValues.consume_all(take);
    mOthers.consume_all(take);
    if (mHasLeftOut.exchange(false, std::memory_order_acquire))
        AddLeftOut(batch);
    std::sort(batch.begin(), batch.end(), [](const Heard& a, const Heard& b) { return a.mNumber < b.mNumber; });
    return batch;
}

// Something of them may wait yet. A unit that is just going still needs its rows: they are left to the next pass, for
// to wait here could be to wait for a reader of this very thread.
void AUListenerBase::DropLostUnits()
{
    std::erase_if(mRows,
                  [this](const RowPtr& row)
                  {
                      const bool isEmptied = row->mTable->IsEmptied();
                      if (isEmptied)
                          mRemoved.push_back(row);
                      else if (row->mTable->IsClosed())
                          LoseUnit();
                      return isEmptied;
                  });
}

void AUListenerBase::AddLeftOut(std::vector<Heard>& batch) const
{
    const UInt64 now = HighPrecisionTime::ConvertToNanos(HighPrecisionTime::GetCurrentTime());
    for (const RowPtr& row : mRows)
    {
        const UInt32 count = row->mLeftOut.exchange(0, std::memory_order_relaxed);
        const UInt64 number = row->mLastLeftOut.load(std::memory_order_relaxed);
        if (count == 0)
            continue;
        if (IsValueChange(row->mEvent))
            batch.push_back({row, number, now, ReadValue(*row), 1});
        else
            batch.push_back({row, number, now, 0.0F, count});
    }
}

// A value that another one follows within the granularity, and without a gesture between them: what was changed
// before a gesture begins or ends is heard before it.
void AUListenerBase::DropSuperseded(std::vector<Heard>& batch)
{
    ++mPart;
    for (auto heard = batch.rbegin(); heard != batch.rend(); ++heard)
    {
        Row& row = *heard->mRow;
        if (!IsValueChange(row.mEvent))
        {
            ++mPart;
            continue;
        }
        const std::chrono::nanoseconds distance(row.mHeardTime - heard->mHostTime);
        if (row.mHeardPart == mPart && distance < mGranularity)
            heard->mTimes = 0;
        row.mHeardPart = mPart;
        row.mHeardTime = heard->mHostTime;
    }
}

void AUListenerBase::Deliver()
{
    std::vector<Heard> batch = Collect();
    DropSuperseded(batch);
    mHeard.insert(mHeard.end(), batch.begin(), batch.end());
    const std::shared_ptr<bool> isAlive = mIsAlive;
    while (*isAlive && !mHeard.empty())
    {
        const Heard heard = mHeard.front();
        if (heard.mTimes > 1)
            --mHeard.front().mTimes;
        else
            mHeard.pop_front();
        if (heard.mTimes > 0 && heard.mRow->mIsWanted && !heard.mRow->mTable->IsClosed())
            mProc(mUserData, heard.mRow->mObject, &heard.mRow->mEvent, heard.mHostTime, heard.mValue);
    }
}
