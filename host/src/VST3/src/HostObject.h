#pragma once

#include <pluginterfaces/base/funknown.h>

#include <atomic>
#include <cstdint>

namespace zebaudiofilterhost::vst3
{

/// The count of an object that plug-ins hold, 1 at first. The SDK's own function reads the value again after
/// changing it, so that two threads can see the same result: this one does not. [any]
class HostReferenceCount
{
public:
    std::uint32_t Add() { return mCount.fetch_add(1, std::memory_order_relaxed) + 1; }

    /// Acquire and release, so that whoever drops the last reference sees what the others did to the object.
    std::uint32_t Remove() { return mCount.fetch_sub(1, std::memory_order_acq_rel) - 1; }

private:
    std::atomic<std::uint32_t> mCount{1};
};

/// The queryInterface of a host object with one interface besides FUnknown. [any]
template <class Interface>
Steinberg::tresult QueryHostObject(Interface& self, const Steinberg::TUID interfaceID, void** object)
{
    if (!object)
        return Steinberg::kInvalidArgument;
    *object = nullptr;
    if (!interfaceID)
        return Steinberg::kNoInterface;
    const bool known = Steinberg::FUnknownPrivate::iidEqual(interfaceID, Interface::iid) ||
                       Steinberg::FUnknownPrivate::iidEqual(interfaceID, Steinberg::FUnknown::iid);
    if (!known)
        return Steinberg::kNoInterface;
    self.addRef();
    *object = &self;
    return Steinberg::kResultOk;
}

} // namespace zebaudiofilterhost::vst3
