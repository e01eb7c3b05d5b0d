#pragma once

#include "examples/effects/gain/GainIds.h"
#include "examples/effects/support/Bases.h"

namespace effects::gain
{

// Multiplies mono, stereo or 5.1 by a gain that follows parameter changes to the sample.
class GainProcessor : public Processor
{
public:
    GainProcessor();

    tresult PLUGIN_API getControllerClassId(TUID classID) override;
    tresult PLUGIN_API setActive(TBool state) override;
    tresult PLUGIN_API process(ProcessData& data) override;
    tresult PLUGIN_API setState(IBStream* state) override { return mParameters.Load(state); }
    tresult PLUGIN_API getState(IBStream* state) override { return mParameters.Save(state); }

protected:
    bool Supports(SpeakerArrangement arrangement) const override;

private:
    float CurrentGain() const;
    void Render(ProcessData& data, int32 first, int32 count, bool& silent) const;

    ParameterSet mParameters = MakeParameters();
};

} // namespace effects::gain
