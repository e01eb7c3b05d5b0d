#pragma once

#include "examples/effects/support/Bases.h"
#include "examples/effects/view/BalanceIds.h"

namespace effects::balance
{

// Turns down the left or the right channel of a stereo signal, and reports its level for the view's meter.
class BalanceProcessor : public Processor
{
public:
    BalanceProcessor();

    tresult PLUGIN_API getControllerClassId(TUID classID) override;
    tresult PLUGIN_API process(ProcessData& data) override;
    tresult PLUGIN_API setState(IBStream* state) override { return mParameters.Load(state); }
    tresult PLUGIN_API getState(IBStream* state) override { return mParameters.Save(state); }

protected:
    bool Supports(SpeakerArrangement arrangement) const override { return arrangement == SpeakerArr::kStereo; }

private:
    float Render(ProcessData& data, int32 first, int32 count) const;
    void ReportLevel(ProcessData& data, float peak);

    ParameterSet mParameters = MakeParameters();
    float mReported = 0.0F; // level that the host was told last
};

} // namespace effects::balance
