#pragma once

#include "host/src/VST3/src/HostObject.h"
#include "host/src/VST3/src/ParameterValueQueue.h"
#include "host/src/VST3/src/PluginPtr.h"

#include <pluginterfaces/vst/ivstparameterchanges.h>

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// All parameter changes of one block, as the plug-in's `process` sees them: one queue for each parameter that
/// changes. Queues are kept from block to block. The filter holds the object by value, with a reference of its own,
/// so that plug-ins never bring the count to 0. [process]
class ParameterChanges final : public Steinberg::Vst::IParameterChanges
{
public:
    using Queues = std::vector<PluginPtr<ParameterValueQueue>>;

    ParameterChanges() = default;
    ~ParameterChanges() = default;

    ParameterChanges(const ParameterChanges&) = delete;
    ParameterChanges& operator=(const ParameterChanges&) = delete;

    /// Makes or drops queues so that `count` different parameters fit into a block without allocating. A negative
    /// count does nothing. [main, suspended]
    void SetMaxParameters(Steinberg::int32 count);

    /// `count` queues that no parameter uses, for Swap. [any]
    static Queues MakeQueues(Steinberg::int32 count);
    /// Exchanges the queues for others without allocating, which has the effect of SetMaxParameters; none is in use
    /// afterwards. [process]
    void Swap(Queues& queues);

    /// Nothing counts as used any more; the queues keep their points until they are used again.
    void ClearQueue() { mUsedCount = 0; }
    bool IsEmpty() const { return mUsedCount == 0; }

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    Steinberg::int32 PLUGIN_API getParameterCount() override;
    /// Null for an index out of range. Owned by this object.
    Steinberg::Vst::IParamValueQueue* PLUGIN_API getParameterData(Steinberg::int32 index) override;
    /// The queue of this ID, with the points that it has when the ID is in use already, otherwise empty. Never null.
    /// Owned by this object.
    Steinberg::Vst::IParamValueQueue* PLUGIN_API addParameterData(const Steinberg::Vst::ParamID& id,
                                                                  Steinberg::int32& index) override;

    /// What addParameterData does.
    ParameterValueQueue* FindOrAppend(Steinberg::Vst::ParamID id, Steinberg::int32& index);
    /// The same for an ID that is known not to be in use yet, without a look.
    ParameterValueQueue& Append(Steinberg::Vst::ParamID id);

private:
    HostReferenceCount mReferenceCount;
    Queues mQueues;
    Steinberg::int32 mUsedCount = 0;
};

} // namespace zebaudiofilterhost::vst3
