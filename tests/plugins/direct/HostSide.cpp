#include "tests/plugins/direct/HostSide.h"

#include <algorithm>
#include <cstring>

namespace zebtest
{

tresult PLUGIN_API DirectAttributes::setInt(AttrID id, int64 value)
{
    mIntegers[id] = value;
    return kResultOk;
}

tresult PLUGIN_API DirectAttributes::getInt(AttrID id, int64& value)
{
    const auto found = mIntegers.find(id);
    if (found == mIntegers.end())
        return kResultFalse;
    value = found->second;
    return kResultOk;
}

tresult PLUGIN_API DirectHost::getName(String128 name)
{
    std::memcpy(name, u"Direct", sizeof(u"Direct"));
    return kResultOk;
}

tresult PLUGIN_API DirectHost::createInstance(TUID classID, TUID, void** object)
{
    const bool known = FUnknownPrivate::iidEqual(classID, IMessage::iid);
    *object = known ? static_cast<IMessage*>(new DirectMessage) : nullptr;
    return known ? kResultOk : kResultFalse;
}

tresult PLUGIN_API DirectHost::beginEdit(ParamID id)
{
    told.push_back("begin " + std::to_string(id));
    return kResultOk;
}

tresult PLUGIN_API DirectHost::performEdit(ParamID id, ParamValue value)
{
    told.push_back("perform " + std::to_string(id));
    lastValue = value;
    return kResultOk;
}

tresult PLUGIN_API DirectHost::endEdit(ParamID id)
{
    told.push_back("end " + std::to_string(id));
    return kResultOk;
}

tresult PLUGIN_API DirectHost::restartComponent(int32 flags)
{
    told.push_back("restart " + std::to_string(flags));
    return kResultOk;
}

tresult PLUGIN_API DirectHost::resizeView(IPlugView*, ViewRect* newSize)
{
    told.push_back("resize " + std::to_string(newSize->getWidth()) + ' ' + std::to_string(newSize->getHeight()));
    return kResultOk;
}

tresult PLUGIN_API DirectHost::registerEventHandler(Linux::IEventHandler* handler, Linux::FileDescriptor fd)
{
    eventHandler = handler;
    descriptor = fd;
    return kResultOk;
}

tresult PLUGIN_API DirectHost::unregisterEventHandler(Linux::IEventHandler*)
{
    eventHandler = nullptr;
    return kResultOk;
}

tresult PLUGIN_API DirectHost::registerTimer(Linux::ITimerHandler* handler, Linux::TimerInterval)
{
    timerHandler = handler;
    return kResultOk;
}

tresult PLUGIN_API DirectHost::unregisterTimer(Linux::ITimerHandler*)
{
    timerHandler = nullptr;
    return kResultOk;
}

tresult PLUGIN_API DirectStream::read(void* buffer, int32 count, int32* done)
{
    const std::size_t size = std::min(static_cast<std::size_t>(count), bytes.size() - mPosition);
    std::memcpy(buffer, bytes.data() + mPosition, size);
    mPosition += size;
    if (done != nullptr)
        *done = static_cast<int32>(size);
    return kResultOk;
}

tresult PLUGIN_API DirectStream::write(void* buffer, int32 count, int32* done)
{
    bytes.resize(mPosition);
    bytes.append(static_cast<const char*>(buffer), static_cast<std::size_t>(count));
    mPosition = bytes.size();
    if (done != nullptr)
        *done = count;
    return kResultOk;
}

tresult PLUGIN_API DirectStream::seek(int64 position, int32 mode, int64*)
{
    if (mode != kIBSeekSet)
        return kNotImplemented;
    mPosition = std::min(static_cast<std::size_t>(position), bytes.size());
    return kResultOk;
}

tresult PLUGIN_API DirectStream::tell(int64* position)
{
    *position = static_cast<int64>(mPosition);
    return kResultOk;
}

tresult PLUGIN_API DirectQueue::getPoint(int32 index, int32& offset, ParamValue& value)
{
    offset = points.at(static_cast<std::size_t>(index)).offset;
    value = points.at(static_cast<std::size_t>(index)).value;
    return kResultOk;
}

tresult PLUGIN_API DirectQueue::addPoint(int32 offset, ParamValue value, int32& index)
{
    index = getPointCount();
    points.push_back({mID, offset, value});
    return kResultOk;
}

IParamValueQueue* PLUGIN_API DirectChanges::getParameterData(int32 index)
{
    return mQueues.at(static_cast<std::size_t>(index));
}

IParamValueQueue* PLUGIN_API DirectChanges::addParameterData(const ParamID& id, int32& index)
{
    const auto same = [id](auto& queue)
    {
        return queue->getParameterId() == id;
    };
    const auto found = std::find_if(mQueues.begin(), mQueues.end(), same);
    index = static_cast<int32>(found - mQueues.begin());
    if (found == mQueues.end())
        mQueues.emplace_back(new DirectQueue(id), false);
    return mQueues[static_cast<std::size_t>(index)];
}

void DirectChanges::Add(const Point& point)
{
    int32 index = 0;
    addParameterData(point.id, index)->addPoint(point.offset, point.value, index);
}

std::vector<Point> DirectChanges::Points() const
{
    std::vector<Point> all;
    for (const auto& queue : mQueues)
        all.insert(all.end(), queue->points.begin(), queue->points.end());
    return all;
}

} // namespace zebtest
