#include "host/src/VST3/src/VST3EventList.h"

#include <algorithm>
#include <cstddef>

namespace zebaudiofilterhost::vst3
{

using Steinberg::int32;
using Steinberg::tresult;
using Steinberg::uint32;
using Steinberg::Vst::Event;

VST3EventList::VST3EventList(int32 maxSize)
{
    SetMaxSize(maxSize);
}

void VST3EventList::SetMaxSize(int32 maxSize)
{
    mEvents.resize(static_cast<std::size_t>(std::max(maxSize, 0)), Event{});
}

Event* VST3EventList::GetEventByIndex(int32 index)
{
    if (index < 0 || index >= mEventCount || static_cast<std::size_t>(index) >= mEvents.size())
        return nullptr;
    return &mEvents[static_cast<std::size_t>(index)];
}

tresult PLUGIN_API VST3EventList::queryInterface(const Steinberg::TUID interfaceID, void** object)
{
    return QueryHostObject<Steinberg::Vst::IEventList>(*this, interfaceID, object);
}

uint32 PLUGIN_API VST3EventList::addRef()
{
    return mReferenceCount.Add();
}

uint32 PLUGIN_API VST3EventList::release()
{
    const uint32 count = mReferenceCount.Remove();
    if (count == 0)
        delete this;
    return count;
}

int32 PLUGIN_API VST3EventList::getEventCount()
{
    return mEventCount;
}

tresult PLUGIN_API VST3EventList::getEvent(int32 index, Event& event)
{
    const Event* stored = GetEventByIndex(index);
    if (!stored)
        return Steinberg::kResultFalse;
    event = *stored;
    return Steinberg::kResultOk;
}

tresult PLUGIN_API VST3EventList::addEvent(Event& event)
{
    const auto count = static_cast<std::size_t>(mEventCount);
    if (count >= mEvents.size())
        return Steinberg::kResultFalse;
    mEvents[count] = event;
    ++mEventCount;
    return Steinberg::kResultOk;
}

} // namespace zebaudiofilterhost::vst3
