#pragma once

#include "examples/effects/support/BusSet.h"
#include "examples/effects/support/Implements.h"

namespace effects
{

// The half of an effect that makes sound, IComponent and IAudioProcessor, with everything an effect seldom wants to
// do otherwise. Base is an Implements<...> with these two interfaces among others.
template <class Base>
class ProcessorPart : public Base
{
public:
    explicit ProcessorPart(BusSet buses) : mBuses(std::move(buses)) {}

    tresult PLUGIN_API initialize(FUnknown* context) override
    {
        mHost = FUnknownPtr<IHostApplication>(context);
        return kResultOk;
    }

    tresult PLUGIN_API terminate() override
    {
        mHost = nullptr;
        return kResultOk;
    }

    tresult PLUGIN_API getControllerClassId(TUID) override { return kNotImplemented; }
    tresult PLUGIN_API setIoMode(IoMode) override { return kNotImplemented; }
    tresult PLUGIN_API getRoutingInfo(RoutingInfo&, RoutingInfo&) override { return kNotImplemented; }

    int32 PLUGIN_API getBusCount(MediaType media, BusDirection direction) override
    {
        return mBuses.Count(media, direction);
    }

    tresult PLUGIN_API getBusInfo(MediaType media, BusDirection direction, int32 index, BusInfo& info) override
    {
        return mBuses.GetInfo(media, direction, index, info);
    }

    tresult PLUGIN_API activateBus(MediaType media, BusDirection direction, int32 index, TBool state) override
    {
        return mBuses.Activate(media, direction, index, state != 0);
    }

    tresult PLUGIN_API setActive(TBool) override { return kResultOk; }

    // All main buses get the same arrangement, one that the effect says it can do.
    // NOLINTNEXTLINE(readability-non-const-parameter): the linter sees no override in a class template
    tresult PLUGIN_API setBusArrangements(SpeakerArrangement* inputs, int32 inputCount, SpeakerArrangement* outputs,
                                          int32 outputCount) override
    {
        if (outputCount < 1 || inputCount < (mBuses.Count(kAudio, kInput) > 0 ? 1 : 0))
            return kResultFalse;
        const SpeakerArrangement wanted = outputs[0];
        if (!Supports(wanted) || (inputCount > 0 && inputs[0] != wanted))
            return kResultFalse;
        mBuses.SetArrangement(kInput, 0, wanted);
        mBuses.SetArrangement(kOutput, 0, wanted);
        return kResultOk;
    }

    tresult PLUGIN_API getBusArrangement(BusDirection direction, int32 index,
                                         SpeakerArrangement& arrangement) override
    {
        arrangement = mBuses.Arrangement(direction, index);
        return mBuses.Find(kAudio, direction, index) != nullptr ? kResultOk : kInvalidArgument;
    }

    tresult PLUGIN_API canProcessSampleSize(int32 size) override
    {
        return size == kSample32 ? kResultOk : kResultFalse;
    }
    uint32 PLUGIN_API getLatencySamples() override { return 0; }
    uint32 PLUGIN_API getTailSamples() override { return kNoTail; }

    tresult PLUGIN_API setupProcessing(ProcessSetup& setup) override
    {
        mSetup = setup;
        return canProcessSampleSize(setup.symbolicSampleSize);
    }

    tresult PLUGIN_API setProcessing(TBool) override { return kResultOk; }

protected:
    virtual bool Supports(SpeakerArrangement arrangement) const
    {
        return arrangement == SpeakerArr::kMono || arrangement == SpeakerArr::kStereo;
    }

    BusSet mBuses;
    ProcessSetup mSetup{kRealtime, kSample32, 1024, 44100.0};
    IPtr<IHostApplication> mHost; // null before initialize, or if the host offers none
};

} // namespace effects
