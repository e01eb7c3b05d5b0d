#pragma once

#include "benchmarks/plugins/BenchSide.h"
#include "examples/effects/support/ProcessorPart.h"

#include <atomic>
#include <vector>

namespace effects::bench
{

using zebaudiofilterhost::benchmarks::BenchSide;

// Stereo, a turn of the sign, and parameters that do nothing but keep their values: next to no work, so that what a
// host adds to it shows. One object, whose IDs are the indices, so that no look-up of its own is measured.
class BenchEffect : public ProcessorPart<Implements<IComponent, IAudioProcessor, IEditController>>, private BenchSide
{
public:
    explicit BenchEffect(int parameters);
    ~BenchEffect() override;

    BenchEffect(const BenchEffect&) = delete;
    BenchEffect& operator=(const BenchEffect&) = delete;

    // The one that was made last and still lives, or null.
    static BenchSide* Latest();

    tresult PLUGIN_API process(ProcessData& data) override;
    tresult PLUGIN_API setState(IBStream* state) override;
    tresult PLUGIN_API getState(IBStream* state) override;

    tresult PLUGIN_API setComponentState(IBStream*) override { return kResultOk; }
    int32 PLUGIN_API getParameterCount() override { return static_cast<int32>(mShown.size()); }
    tresult PLUGIN_API getParameterInfo(int32 index, ParameterInfo& info) override;
    tresult PLUGIN_API getParamStringByValue(ParamID id, ParamValue value, String128 text) override;
    tresult PLUGIN_API getParamValueByString(ParamID, TChar*, ParamValue&) override { return kNotImplemented; }
    ParamValue PLUGIN_API normalizedParamToPlain(ParamID, ParamValue value) override { return value; }
    ParamValue PLUGIN_API plainParamToNormalized(ParamID, ParamValue value) override { return value; }
    ParamValue PLUGIN_API getParamNormalized(ParamID id) override;
    tresult PLUGIN_API setParamNormalized(ParamID id, ParamValue value) override;
    tresult PLUGIN_API setComponentHandler(IComponentHandler* handler) override;
    IPlugView* PLUGIN_API createView(FIDString) override { return nullptr; }

private:
    void PerformEdits(int first, int count, double value) override;
    long long GetPointsReceived() const override { return mPoints; }
    double GetProcessedValue(int id) const override { return mProcessed.at(static_cast<std::size_t>(id)); }

    void TakePoints(IParameterChanges& changes);

    std::vector<std::atomic<double>> mShown; // the controller's values
    std::vector<double> mProcessed;          // the processor's
    long long mPoints = 0;
    IPtr<IComponentHandler> mHandler; // null until the host sets it
};

} // namespace effects::bench
