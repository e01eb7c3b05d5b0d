#pragma once

#include "examples/effects/support/ProcessorPart.h"
#include "tests/plugins/support/Bytes.h"
#include "tests/plugins/support/Engine.h"
#include "tests/plugins/support/FixtureObject.h"
#include "tests/plugins/support/HostAccess.h"
#include "tests/plugins/support/RunLoopUser.h"
#include "tests/plugins/support/VendorInterfaces.h"

#include <string_view>

namespace fixture
{

inline std::string_view NameOfMedia(MediaType media)
{
    return media == kAudio ? "audio" : "event";
}

inline std::string_view NameOfDirection(BusDirection direction)
{
    return direction == kInput ? "in" : "out";
}

// A component and processor that records what is called and behaves as the knobs say.
template <class Base>
class FixtureProcessorPart : public ProcessorPart<Base>
{
    using Part = ProcessorPart<Base>;

public:
    FixtureProcessorPart() : Part(BusSet(TheBehaviour().inputs, TheBehaviour().outputs))
    {
        Record("component.created");
    }

    ~FixtureProcessorPart() override { Record("component.destroyed"); }

    tresult PLUGIN_API initialize(FUnknown* context) override
    {
        Record("component.initialize");
        Happen(TheBehaviour().atInitialize);
        SetHostContext(context);
        if (TheBehaviour().usesRunLoop)
        {
            mRunLoopUser = IPtr<RunLoopUser>(new RunLoopUser, false);
            mRunLoopUser->Register(context);
            SetNewestRunLoopUser(mRunLoopUser);
        }
        Part::initialize(context);
        return GetInt(Knob::kInitializeResult);
    }

    tresult PLUGIN_API terminate() override
    {
        Record("component.terminate");
        if (mRunLoopUser != nullptr)
        {
            SetNewestRunLoopUser(nullptr);
            mRunLoopUser->Unregister();
            mRunLoopUser = nullptr;
        }
        SetHostContext(nullptr);
        return Part::terminate();
    }

    int32 PLUGIN_API getBusCount(MediaType media, BusDirection direction) override
    {
        const int32 real = Part::getBusCount(media, direction);
        return media == kAudio ? GetInt(Knob::kBusCount, real) : real;
    }

    tresult PLUGIN_API getBusInfo(MediaType media, BusDirection direction, int32 index, BusInfo& info) override
    {
        const tresult result = Part::getBusInfo(media, direction, index, info);
        return media == kAudio && IsFailing(index) && IsOn(Knob::kBusInfoResult) ? GetInt(Knob::kBusInfoResult)
                                                                                 : result;
    }

    tresult PLUGIN_API activateBus(MediaType media, BusDirection direction, int32 index, TBool state) override
    {
        Record("component.activateBus", NameOfMedia(media), NameOfDirection(direction), index,
               static_cast<int>(state));
        return Part::activateBus(media, direction, index, state);
    }

    tresult PLUGIN_API setActive(TBool state) override
    {
        Record("component.setActive", static_cast<int>(state));
        return kResultOk;
    }

    tresult PLUGIN_API setState(IBStream* state) override
    {
        mState = ReadAll(state);
        mStateIsSet = GetInt(Knob::kSetStateResult) == kResultOk;
        Record("component.setState", Summary(mState));
        return GetInt(Knob::kSetStateResult);
    }

    tresult PLUGIN_API getState(IBStream* state) override
    {
        Record("component.getState");
        if (IsOn(Knob::kStateResult))
            return GetInt(Knob::kStateResult);
        const int size = GetInt(Knob::kStateSize, kDefaultStateSize);
        return WriteAll(state, mStateIsSet ? mState : Pattern(static_cast<std::size_t>(size)));
    }

    // The wanted arrangements, each bus by itself, for those buses that there are.
    tresult PLUGIN_API setBusArrangements(SpeakerArrangement* inputs, int32 inputCount, SpeakerArrangement* outputs,
                                          int32 outputCount) override
    {
        Record("processor.setBusArrangements", ListOf(inputs, inputCount), ListOf(outputs, outputCount));
        if (!IsOn(Knob::kAcceptArrangements))
            return kResultFalse;
        for (int32 i = 0; i < inputCount; ++i)
            this->mBuses.SetArrangement(kInput, i, inputs[i]);
        for (int32 i = 0; i < outputCount; ++i)
            this->mBuses.SetArrangement(kOutput, i, outputs[i]);
        return kResultOk;
    }

    tresult PLUGIN_API getBusArrangement(BusDirection direction, int32 index,
                                         SpeakerArrangement& arrangement) override
    {
        if (IsOn(Knob::kBusArrangementResult) && IsFailing(index))
            return GetInt(Knob::kBusArrangementResult);
        return Part::getBusArrangement(direction, index, arrangement);
    }

    uint32 PLUGIN_API getLatencySamples() override
    {
        Record("processor.getLatencySamples");
        return static_cast<uint32>(Get(Knob::kLatency));
    }

    uint32 PLUGIN_API getTailSamples() override { return static_cast<uint32>(Get(Knob::kTail)); }

    tresult PLUGIN_API setupProcessing(ProcessSetup& setup) override
    {
        Record("processor.setupProcessing", setup.processMode, setup.symbolicSampleSize, setup.maxSamplesPerBlock,
               setup.sampleRate);
        return Part::setupProcessing(setup);
    }

    tresult PLUGIN_API setProcessing(TBool state) override
    {
        Record("processor.setProcessing", static_cast<int>(state));
        mEngine.SetProcessing(state != 0);
        return kResultOk;
    }

    tresult PLUGIN_API process(ProcessData& data) override { return mEngine.Process(data); }

private:
    static constexpr int kDefaultStateSize = 24;

    static bool IsFailing(int32 index)
    {
        return GetInt(Knob::kFailingBus) == -1 || GetInt(Knob::kFailingBus) == index;
    }

    static std::string ListOf(const SpeakerArrangement* arrangements, int32 count)
    {
        std::string text;
        for (int32 i = 0; i < count; ++i)
        {
            text += i > 0 ? "," : "";
            AddWord(text, arrangements[i]);
        }
        return text.empty() ? "-" : text;
    }

    Engine mEngine;
    std::string mState;
    bool mStateIsSet = false;
    IPtr<RunLoopUser> mRunLoopUser;
};

} // namespace fixture
