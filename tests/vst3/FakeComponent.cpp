#include "tests/vst3/FakeObject.h"

#include "host/src/VST3/src/VST3VendorInterfaces.h"

#include <pluginterfaces/vst/ivstmessage.h>

namespace fakeplugin
{

using zebaudiofilterhost::vst3::IVST3CorvaneVendorSpecificComponent;

namespace
{

std::string Text(int64 value)
{
    return " " + std::to_string(value);
}

class FakeComponent final : public IComponent,
                            public IAudioProcessor,
                            public IConnectionPoint,
                            public IVST3CorvaneVendorSpecificComponent
{
public:
    explicit FakeComponent(FakePlugin& plugin) : mPlugin(plugin), mCount(plugin, "component") {}
    ~FakeComponent()
    {
        if (mController)
            mController->release();
    }
    FakeComponent(const FakeComponent&) = delete;
    FakeComponent& operator=(const FakeComponent&) = delete;

    tresult PLUGIN_API queryInterface(const TUID asked, void** obj) override
    {
        *obj = nullptr;
        const bool answered =
            Answer<IComponent>(asked, this, obj) ||
            (mPlugin.hasProcessor && Answer<IAudioProcessor>(asked, this, obj)) ||
            (mPlugin.hasConnections && Answer<IConnectionPoint>(asked, this, obj)) ||
            (!mPlugin.vendorName.empty() && Answer<IVST3CorvaneVendorSpecificComponent>(asked, this, obj));
        if (answered)
            return kResultOk;
        if (mPlugin.controllerKind != ControllerKind::kSame || !Is(asked, IEditController::iid))
            return kNoInterface;
        if (!mController)
            mController = MakeFakeController(mPlugin);
        mController->addRef();
        *obj = mController;
        return kResultOk;
    }
    uint32 PLUGIN_API addRef() override { return mCount.Add(); }
    uint32 PLUGIN_API release() override { return mCount.Release(this); }

    tresult PLUGIN_API initialize(FUnknown* context) override
    {
        mPlugin.Call("component.initialize");
        mPlugin.hostContext = context;
        return mPlugin.initializeResult;
    }
    tresult PLUGIN_API terminate() override
    {
        mPlugin.Call("component.terminate");
        return kResultOk;
    }
    tresult PLUGIN_API getControllerClassId(TUID classID) override
    {
        if (mPlugin.controllerKind != ControllerKind::kSeparate)
            return kResultFalse;
        kControllerClass.toTUID(classID);
        return kResultOk;
    }
    tresult PLUGIN_API setIoMode(IoMode /*mode*/) override { return kNotImplemented; }
    int32 PLUGIN_API getBusCount(MediaType type, BusDirection direction) override
    {
        if (type == kEvent)
            return direction == kInput ? mPlugin.eventInputs : mPlugin.eventOutputs;
        const int32 real = static_cast<int32>(Buses(direction).size());
        return mPlugin.audioBusCount == -1 ? real : mPlugin.audioBusCount;
    }
    tresult PLUGIN_API getBusInfo(MediaType type, BusDirection direction, int32 index, BusInfo& info) override
    {
        if (type != kAudio || index >= static_cast<int32>(Buses(direction).size()))
            return kInvalidArgument;
        const FakeBus& bus = Buses(direction)[static_cast<std::size_t>(index)];
        CopyText(info.name, bus.name);
        info.busType = bus.type;
        return bus.infoResult;
    }
    tresult PLUGIN_API getRoutingInfo(RoutingInfo& /*in*/, RoutingInfo& /*out*/) override { return kNotImplemented; }
    tresult PLUGIN_API activateBus(MediaType /*type*/, BusDirection direction, int32 index, TBool state) override
    {
        mPlugin.Call(std::string("component.activateBus ") + (direction == kInput ? "in" : "out") + Text(index) +
                     Text(state));
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API setActive(TBool state) override
    {
        mPlugin.Call("component.setActive" + Text(state));
        return kResultOk;
    }
    tresult PLUGIN_API setState(IBStream* stream) override
    {
        mPlugin.state = ReadState(stream);
        mPlugin.Call("component.setState " + mPlugin.state);
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API getState(IBStream* stream) override
    {
        mPlugin.Call("component.getState");
        return WriteState(stream, mPlugin.state, mPlugin.getStateResult);
    }

    tresult PLUGIN_API setBusArrangements(SpeakerArrangement* inputs, int32 inputCount, SpeakerArrangement* outputs,
                                          int32 outputCount) override
    {
        std::string call = "processor.setBusArrangements";
        for (int32 index = 0; index < inputCount; ++index)
            call += Text(static_cast<int64>(inputs[index]));
        call += " ->";
        for (int32 index = 0; index < outputCount; ++index)
            call += Text(static_cast<int64>(outputs[index]));
        mPlugin.Call(call);
        if (mPlugin.setArrangementsResult != kResultOk)
            return mPlugin.setArrangementsResult;
        for (std::size_t index = 0; index < std::min<std::size_t>(mPlugin.inputs.size(), std::size_t(inputCount));
             ++index)
            mPlugin.inputs[index].arrangement = inputs[index];
        for (std::size_t index = 0; index < std::min<std::size_t>(mPlugin.outputs.size(), std::size_t(outputCount));
             ++index)
            mPlugin.outputs[index].arrangement = outputs[index];
        return kResultOk;
    }
    tresult PLUGIN_API getBusArrangement(BusDirection direction, int32 index,
                                         SpeakerArrangement& arrangement) override
    {
        if (index >= static_cast<int32>(Buses(direction).size()))
            return kInvalidArgument;
        const FakeBus& bus = Buses(direction)[static_cast<std::size_t>(index)];
        arrangement = bus.arrangement;
        return bus.arrangementResult;
    }
    tresult PLUGIN_API canProcessSampleSize(int32 /*size*/) override { return kResultOk; }
    uint32 PLUGIN_API getLatencySamples() override
    {
        mPlugin.Call("processor.getLatencySamples");
        return mPlugin.latency;
    }
    tresult PLUGIN_API setupProcessing(ProcessSetup& setup) override
    {
        mPlugin.Call("processor.setupProcessing" + Text(setup.processMode) + Text(setup.symbolicSampleSize) +
                     Text(setup.maxSamplesPerBlock) + Text(static_cast<int64>(setup.sampleRate)));
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API setProcessing(TBool state) override
    {
        mPlugin.Call("processor.setProcessing" + Text(state));
        return kNotImplemented; // the host must not mind
    }
    tresult PLUGIN_API process(ProcessData& data) override
    {
        if (mPlugin.recording)
            mPlugin.Call("processor.process" + Text(data.numSamples));
        return mPlugin.process ? mPlugin.process(data) : kResultOk;
    }
    uint32 PLUGIN_API getTailSamples() override { return mPlugin.tail; }

    tresult PLUGIN_API connect(IConnectionPoint* /*other*/) override
    {
        mPlugin.Call("component.connect");
        return kResultFalse; // the host must not mind
    }
    tresult PLUGIN_API disconnect(IConnectionPoint* /*other*/) override
    {
        mPlugin.Call("component.disconnect");
        return kResultOk;
    }
    tresult PLUGIN_API notify(IMessage* /*message*/) override { return kResultOk; }

    int32 PLUGIN_API GetDisplayNameLength() override
    {
        return mPlugin.vendorNameLength == -1 ? static_cast<int32>(mPlugin.vendorName.size())
                                              : mPlugin.vendorNameLength;
    }
    void PLUGIN_API GetDisplayName(char* buffer) override
    {
        std::copy(mPlugin.vendorName.begin(), mPlugin.vendorName.end(), buffer);
    }

private:
    std::vector<FakeBus>& Buses(BusDirection direction)
    {
        return direction == kInput ? mPlugin.inputs : mPlugin.outputs;
    }

    FakePlugin& mPlugin;
    FakeCount mCount;
    IEditController* mController = nullptr;
};

} // namespace

IComponent* MakeFakeComponent(FakePlugin& plugin)
{
    return new FakeComponent(plugin);
}

} // namespace fakeplugin
