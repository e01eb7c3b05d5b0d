#pragma once

#include "benchmarks/process/DirectChanges.h"
#include "benchmarks/process/Way.h"

#include <pluginterfaces/base/smartpointer.h>
#include <pluginterfaces/vst/ivstaudioprocessor.h>
#include <pluginterfaces/vst/ivstcomponent.h>
#include <pluginterfaces/vst/ivstprocesscontext.h>

#include <array>
#include <string>

namespace zebaudiofilterhost::benchmarks
{

/// The plug-in without a host: IAudioProcessor::process with data that was prepared once. What nothing can undercut.
class DirectWay final : public Way
{
public:
    /// Throws std::runtime_error when the effect does not come up.
    DirectWay(const std::string& effect, int frames);
    ~DirectWay() override;

    void Process(float** channels, int frames) override;
    void PostChanges(int count, float value) override;
    BenchSide& GetSide() override { return *mSide; }

private:
    void Activate(int frames);

    DirectChanges mChanges;
    DirectChanges mOutputChanges;
    Steinberg::IPtr<Steinberg::Vst::IComponent> mComponent;
    Steinberg::IPtr<Steinberg::Vst::IAudioProcessor> mProcessor;
    BenchSide* mSide = nullptr;
    std::array<float*, 2> mChannels{};
    Steinberg::Vst::AudioBusBuffers mInput;
    Steinberg::Vst::AudioBusBuffers mOutput;
    Steinberg::Vst::ProcessContext mContext{};
    Steinberg::Vst::ProcessData mData;
};

} // namespace zebaudiofilterhost::benchmarks
