#pragma once

#include "host/src/VST3/src/HostObject.h"
#include "host/src/VST3/src/ParameterQueueValue.h"

#include <pluginterfaces/vst/ivstparameterchanges.h>

#include <vector>

namespace zebaudiofilterhost::vst3
{

/// The points of one parameter in one block, as the plug-in's `process` sees them. Counted from 1, deletes itself at
/// 0. [process]
class ParameterValueQueue final : public Steinberg::Vst::IParamValueQueue
{
public:
    /// Reserves room for kMaxPointsPerParameter points. [any]
    explicit ParameterValueQueue(Steinberg::Vst::ParamID id);

    ParameterValueQueue(const ParameterValueQueue&) = delete;
    ParameterValueQueue& operator=(const ParameterValueQueue&) = delete;

    Steinberg::tresult PLUGIN_API queryInterface(const Steinberg::TUID interfaceID, void** object) override;
    Steinberg::uint32 PLUGIN_API addRef() override;
    Steinberg::uint32 PLUGIN_API release() override;

    Steinberg::Vst::ParamID PLUGIN_API getParameterId() override;
    Steinberg::int32 PLUGIN_API getPointCount() override;
    /// kResultFalse, with nothing written, for an index out of range.
    Steinberg::tresult PLUGIN_API getPoint(Steinberg::int32 index, Steinberg::int32& sampleOffset,
                                           Steinberg::Vst::ParamValue& value) override;
    /// Keeps the points in order of offset; a point of the same offset gets the new value. `index` becomes the
    /// position. Always kResultOk; allocates only beyond the reserve.
    Steinberg::tresult PLUGIN_API addPoint(Steinberg::int32 sampleOffset, Steinberg::Vst::ParamValue value,
                                           Steinberg::int32& index) override;

    /// Keeps the memory.
    void Clear() { mValues.clear(); }
    void SetParameterID(Steinberg::Vst::ParamID id) { mParameterID = id; }
    Steinberg::Vst::ParamID GetParameterID() const { return mParameterID; }

private:
    ~ParameterValueQueue() = default;

    HostReferenceCount mReferenceCount;
    Steinberg::Vst::ParamID mParameterID;
    std::vector<ParameterQueueValue> mValues; // by ascending offset
};

} // namespace zebaudiofilterhost::vst3
