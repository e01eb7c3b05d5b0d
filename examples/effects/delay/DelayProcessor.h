#pragma once

#include "examples/effects/delay/DelayIds.h"
#include "examples/effects/delay/DelayRing.h"
#include "examples/effects/support/Bases.h"

#include <array>
#include <atomic>

namespace effects::delay
{

// Repeats its input, and has a latency: a real effect would look ahead in that time, this one just waits. Mono and
// stereo.
class DelayProcessor : public Processor
{
public:
    DelayProcessor();

    tresult PLUGIN_API getControllerClassId(TUID classID) override;
    tresult PLUGIN_API setActive(TBool state) override;
    tresult PLUGIN_API process(ProcessData& data) override;
    uint32 PLUGIN_API getLatencySamples() override;
    uint32 PLUGIN_API getTailSamples() override;
    tresult PLUGIN_API setState(IBStream* state) override { return mParameters.Load(state); }
    tresult PLUGIN_API getState(IBStream* state) override { return mParameters.Save(state); }
    tresult PLUGIN_API notify(IMessage* message) override;

private:
    struct Channel
    {
        DelayRing input;
        DelayRing repeats;
    };

    std::size_t TimeInSamples() const;
    void Render(ProcessData& data, int32 first, int32 count);

    ParameterSet mParameters = MakeParameters();
    std::array<Channel, 2> mChannels;

    // What the audio thread works with. A new look-ahead is announced at once and comes into force here with the next
    // activation, which is when the host takes the latency into account.
    std::size_t mLookAhead = 0;
};

} // namespace effects::delay
