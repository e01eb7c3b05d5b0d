#pragma once

#include "host/src/VST3/src/HostObject.h"

#include <pluginterfaces/vst/ivstevents.h>

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// Events of one block, in a store of fixed size. Counted from 1, deletes itself at 0; whoever makes one drops it
/// with `release`. [process]
class VST3EventList final : public Steinberg::Vst::IEventList
{
public:
    /// A negative size counts as 0. [main]
    explicit VST3EventList(Steinberg::int32 maxSize);

    VST3EventList(const VST3EventList&) = delete;
    VST3EventList& operator=(const VST3EventList&) = delete;

    /// Leaves the count alone; events beyond the store are out of range. [main, suspended]
    void SetMaxSize(Steinberg::int32 maxSize);
    void Clear() { mEventCount = 0; }
    /// Null for an index out of range.
    Steinberg::Vst::Event* GetEventByIndex(Steinberg::int32 index);

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    Steinberg::int32 PLUGIN_API getEventCount() override;
    /// kResultFalse, with nothing written, for an index out of range.
    Steinberg::tresult PLUGIN_API getEvent(Steinberg::int32 index, Steinberg::Vst::Event& event) override;
    /// kResultFalse once the store is full.
    Steinberg::tresult PLUGIN_API addEvent(Steinberg::Vst::Event& event) override;

private:
    ~VST3EventList() = default;

    HostReferenceCount mReferenceCount;
    std::vector<Steinberg::Vst::Event> mEvents; // its size is the capacity
    Steinberg::int32 mEventCount = 0;
};

} // namespace zebaudiofilterhost::vst3
