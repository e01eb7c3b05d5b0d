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

void AppendTo(ParameterChanges& changes, ParamID id, const ParameterQueueValue& value)
{
    int32 index = 0;
    if (Steinberg::Vst::IParamValueQueue* queue = changes.addParameterData(id, index))
        queue->addPoint(value.mSampleOffset, value.mValue, index);
}

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

bool ParameterChangeTransfer::TransferChangesTo(ParameterChanges& changes)
{
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    bool any = false;
    table.TakeAll(
        [&](ParamID id, const ParameterQueueValue& value)
        {
            AppendTo(changes, id, value);
            any = true;
        });
    return any;
}

bool ParameterChangeTransfer::TransferChangesFrom(ParameterChanges& changes)
{
    const Table::Reader reader(mTable);
    ParameterChangeTable& table = **reader;
    bool any = false;
    for (int32 index = 0; index < changes.getParameterCount(); ++index)
    {
        if (Steinberg::Vst::IParamValueQueue* queue = changes.getParameterData(index))
            any = ReadQueue(table, *queue) || any;
    }
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
    other.FreeRetired();
}

} // namespace zebaudiofilterhost::vst3
