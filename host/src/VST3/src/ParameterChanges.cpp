#include "host/src/VST3/src/ParameterChanges.h"

#include <algorithm>
#include <cstddef>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::tresult;
using Steinberg::uint32;
using Steinberg::Vst::ParamID;

namespace
{

constexpr ParamID kUnusedQueue = 0xffffffff;

PluginPtr<ParameterValueQueue> MakeQueue(ParamID id)
{
    return PluginPtr<ParameterValueQueue>::Adopt(new ParameterValueQueue(id));
}

} // namespace

void ParameterChanges::SetMaxParameters(int32 count)
{
    if (count < 0)
        return;
    const auto size = static_cast<std::size_t>(count);
    while (mQueues.size() < size)
        mQueues.push_back(MakeQueue(kUnusedQueue));
    while (mQueues.size() > size)
        mQueues.pop_back();
    mUsedCount = std::min(mUsedCount, count);
}

ParameterChanges::Queues ParameterChanges::MakeQueues(int32 count)
{
    Queues queues;
    queues.reserve(static_cast<std::size_t>(count));
    for (int32 index = 0; index < count; ++index)
        queues.push_back(MakeQueue(kUnusedQueue));
    return queues;
}

void ParameterChanges::Swap(Queues& queues)
{
    mQueues.swap(queues);
    mUsedCount = 0;
}

tresult PLUGIN_API ParameterChanges::queryInterface(const Steinberg::TUID interfaceID, void** object)
{
    return QueryHostObject<Steinberg::Vst::IParameterChanges>(*this, interfaceID, object);
}

uint32 PLUGIN_API ParameterChanges::addRef()
{
    return mReferenceCount.Add();
}

uint32 PLUGIN_API ParameterChanges::release()
{
    return mReferenceCount.Remove();
}

int32 PLUGIN_API ParameterChanges::getParameterCount()
{
    return mUsedCount;
}

Steinberg::Vst::IParamValueQueue* PLUGIN_API ParameterChanges::getParameterData(int32 index)
{
    if (index < 0 || index >= mUsedCount)
        return nullptr;
    return mQueues[static_cast<std::size_t>(index)].Get();
}

Steinberg::Vst::IParamValueQueue* PLUGIN_API ParameterChanges::addParameterData(const ParamID& id, int32& index)
{
    return FindOrAppend(id, index);
}

ParameterValueQueue* ParameterChanges::FindOrAppend(ParamID id, int32& index)
{
    for (int32 used = 0; used < mUsedCount; ++used)
    {
        ParameterValueQueue& queue = *mQueues[static_cast<std::size_t>(used)];
        if (queue.GetParameterID() == id)
        {
            index = used;
            return &queue;
        }
    }
    index = mUsedCount;
    return &Append(id);
}

ParameterValueQueue& ParameterChanges::Append(ParamID id)
{
    const auto next = static_cast<std::size_t>(mUsedCount);
    if (next < mQueues.size())
    {
        mQueues[next]->SetParameterID(id);
        mQueues[next]->Clear();
    }
    else
        mQueues.push_back(MakeQueue(id));
    ++mUsedCount;
    return *mQueues[next];
}

} // namespace zebaudiofilterhost::vst3
