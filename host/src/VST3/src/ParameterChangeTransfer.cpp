#include "host/src/VST3/src/ParameterChangeTransfer.h"

#include <algorithm>
#include <memory>
#include <utility>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::Vst::ParamID;

namespace
{

// Takes changes by ascending ID, so that each ID is looked up once.
class Appender
{
public:
    explicit Appender(ParameterChanges& changes) : mChanges(changes), mWasEmpty(changes.IsEmpty()) {}

    void Add(ParamID id, const ParameterQueueValue& value)
    {
        if (mQueue == nullptr || mID != id)
            mQueue = Find(id);
        mID = id;
        int32 index = 0;
        mQueue->addPoint(value.mSampleOffset, value.mValue, index);
        mAny = true;
    }

    bool HasAny() const { return mAny; }

private:
    ParameterValueQueue* Find(ParamID id)
    {
        int32 index = 0;
        return mWasEmpty ? &mChanges.Append(id) : mChanges.FindOrAppend(id, index);
    }

    ParameterChanges& mChanges;
    const bool mWasEmpty;
    ParameterValueQueue* mQueue = nullptr;
    ParamID mID = 0;
    bool mAny = false;
};

// True if a point could be read, whether its ID is known or not.
bool ReadQueue(ParameterChangeTable& table, Steinberg::Vst::IParamValueQueue& queue)
{
    bool any = false;
    const ParamID id = queue.getParameterId();
    for (int32 index = 0; index < queue.getPointCount(); ++index)
    {
        ParameterQueueValue value;
        if (queue.getPoint(index, value.mSampleOffset, value.mValue) != Steinberg::kResultOk)
            continue;
        table.Write(id, value);
        any = true;
    }
    return any;
}

} // namespace

ParameterChangeTransfer::ParameterChangeTransfer()
{
    mTable.Publish(std::make_unique<ParameterChangeTable>(std::vector<ParamID>()));
    mTable.FreeRetired();
}

void ParameterChangeTransfer::SetParameterIDs(const std::vector<ParamID>& ids)
{
    std::vector<ParamID> sorted(ids);
    std::sort(sorted.begin(), sorted.end());
    sorted.erase(std::unique(sorted.begin(), sorted.end()), sorted.end());
    {
        // Plug-ins that announce new values or titles rarely have new IDs: the rings can stay.
        const Table::Reader reader(mTable);
        ParameterChangeTable& table = **reader;
        if (table.GetIDs() == sorted)
        {
            table.DiscardAll();
            return;
        }
    }
    mTable.Publish(std::make_unique<ParameterChangeTable>(std::move(sorted)));
}

void ParameterChangeTransfer::FreeRetired()
{
    mTable.FreeRetired();
}

void ParameterChangeTransfer::AddChange(ParamID id, double value, int32 sampleOffset)
{
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    table.Write(id, {value, sampleOffset});
    MarkWritten();
}

void ParameterChangeTransfer::Discard()
{
    const Table::Reader reader(mTable);
    (*reader)->DiscardAll();
}

// Behind the write. An exchange, and not a store, so that who takes the mark off sees what everybody wrote who had
// set it.
void ParameterChangeTransfer::MarkWritten()
{
    mWritten.exchange(true, std::memory_order_acq_rel);
}

bool ParameterChangeTransfer::HasChanges() const
{
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    return table.MayHaveChanges();
}

bool ParameterChangeTransfer::GetNextChange(ParamID id, double& value, int32& sampleOffset)
{
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    ParameterQueueValue change;
    if (!table.Read(id, change))
        return false;
    value = change.mValue;
    sampleOffset = change.mSampleOffset;
    return true;
}

bool ParameterChangeTransfer::MoveAll(ParameterChanges& changes)
{
    // Ahead of the look: what is written from here on is marked anew, also when it goes into another table.
    mWritten.exchange(false, std::memory_order_acq_rel);
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    Appender appender(changes);
    table.TakeAll([&appender](ParamID id, const ParameterQueueValue& value) { appender.Add(id, value); });
    return appender.HasAny();
}

bool ParameterChangeTransfer::ReadAll(ParameterChanges& changes)
{
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    bool any = false;
    for (int32 index = 0; index < changes.getParameterCount(); ++index)
    {
        if (Steinberg::Vst::IParamValueQueue* queue = changes.getParameterData(index))
            any = ReadQueue(table, *queue) || any;
    }
    MarkWritten();
    return any;
}

void ParameterChangeTransfer::CopyTo(ParameterChangeTransfer& other) const
{
    if (&other == this)
        return;
    std::unique_ptr<ParameterChangeTable> copy;
    {
        const Table::Reader reader(mTable);
        ParameterChangeTable& table = **reader;
        copy = std::make_unique<ParameterChangeTable>(table.GetIDs());
        table.CopyTo(*copy);
    }
    other.mTable.Publish(std::move(copy));
    other.MarkWritten();
    other.FreeRetired();
}

} // namespace zebaudiofilterhost::vst3
