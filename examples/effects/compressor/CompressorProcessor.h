#pragma once

#include "examples/effects/compressor/CompressorIds.h"
#include "examples/effects/support/Bases.h"

namespace effects::compressor
{

// Turns down what is loud, or, when the side-chain bus is active, whenever the side-chain is loud.
class CompressorProcessor : public Processor
{
public:
    CompressorProcessor();

    tresult PLUGIN_API getControllerClassId(TUID classID) override;
    tresult PLUGIN_API setBusArrangements(SpeakerArrangement* inputs, int32 inputCount, SpeakerArrangement* outputs,
                                          int32 outputCount) override;
    tresult PLUGIN_API setActive(TBool state) override;
    tresult PLUGIN_API process(ProcessData& data) override;
    tresult PLUGIN_API setState(IBStream* state) override { return mParameters.Load(state); }
    tresult PLUGIN_API getState(IBStream* state) override { return mParameters.Save(state); }

private:
    float Follow(float level);
    void Render(ProcessData& data, int32 first, int32 count);
    void ReportReduction(ProcessData& data);

    ParameterSet mParameters = MakeParameters();
    float mEnvelope = 0.0F;  // level that the detector sees, linear
    double mReduction = 0.0; // dB, the most in this block
    double mReported = 0.0;  // what the host was told last
    float mAttackPerSample = 1.0F;
    float mReleasePerSample = 1.0F;
};

} // namespace effects::compressor
