#include "benchmarks/process/DirectWay.h"

#include "benchmarks/process/BenchBundle.h"

#include <pluginterfaces/base/ipluginbase.h>
#include <pluginterfaces/vst/ivsteditcontroller.h>

#include <stdexcept>

namespace zebaudiofilterhost::benchmarks
{

using namespace Steinberg;
using namespace Steinberg::Vst;

namespace
{

// Both take the interface's ID as plain bytes: the objects that the SDK has for these are in its library.
template <class Interface, class Give>
IPtr<Interface> Get(Give give)
{
    void* object = nullptr;
    if (give(&object) != kResultOk || object == nullptr)
        return nullptr;
    return owned(static_cast<Interface*>(object));
}

template <class Interface>
IPtr<Interface> Query(FUnknown& object, const TUID id)
{
    return Get<Interface>([&](void** face) { return object.queryInterface(id, face); });
}

IPtr<IComponent> CreateComponent(const std::string& effect)
{
    const BenchBundle& bundle = BenchBundle::GetInstance();
    bundle.Find<bool (*)(void*)>("ModuleEntry")(bundle.GetHandle());
    IPluginFactory* const factory = bundle.Find<IPluginFactory* (*)()>("GetPluginFactory")();
    PClassInfo info{};
    for (int32 index = 0; factory->getClassInfo(index, &info) == kResultOk; ++index)
        if (effect == info.name)
            if (auto component = Get<IComponent>(
                    [&](void** object) { return factory->createInstance(info.cid, IComponent_iid, object); }))
                return component;
    throw std::runtime_error("no effect called " + effect);
}

} // namespace

DirectWay::DirectWay(const std::string& effect, int frames) : mComponent(CreateComponent(effect))
{
    mSide = &BenchBundle::GetInstance().GetLatestSide();
    mProcessor = Query<IAudioProcessor>(*mComponent, IAudioProcessor_iid);
    const auto controller = Query<IEditController>(*mComponent, IEditController_iid);
    if (mComponent->initialize(nullptr) != kResultOk || !mProcessor || !controller)
        throw std::runtime_error(effect + " does not come up");
    controller->setComponentHandler(&mChanges);
    Activate(frames);

    mContext.sampleRate = kSampleRate;
    mInput.numChannels = mOutput.numChannels = static_cast<int32>(mChannels.size());
    mInput.channelBuffers32 = mOutput.channelBuffers32 = mChannels.data();
    mData.numInputs = mData.numOutputs = 1;
    mData.inputs = &mInput;
    mData.outputs = &mOutput;
    mData.inputParameterChanges = &mChanges;
    mData.outputParameterChanges = &mOutputChanges;
    mData.processContext = &mContext;
}

void DirectWay::Activate(int frames)
{
    SpeakerArrangement stereo = SpeakerArr::kStereo;
    mProcessor->setBusArrangements(&stereo, 1, &stereo, 1);
    mComponent->activateBus(kAudio, kInput, 0, 1);
    mComponent->activateBus(kAudio, kOutput, 0, 1);
    ProcessSetup setup{kRealtime, kSample32, frames, kSampleRate};
    mProcessor->setupProcessing(setup);
    mComponent->setActive(1);
    mProcessor->setProcessing(1);
}

DirectWay::~DirectWay()
{
    mProcessor->setProcessing(0);
    mComponent->setActive(0);
    mComponent->terminate();
}

void DirectWay::Process(float** channels, int frames)
{
    mChannels = {channels[0], channels[1]};
    mData.numSamples = frames;
    mProcessor->process(mData);
    mChanges.Clear();
}

void DirectWay::PostChanges(int count, float value)
{
    for (int index = 0; index < count; ++index)
        mChanges.Add(static_cast<ParamID>(index), static_cast<double>(value));
}

} // namespace zebaudiofilterhost::benchmarks
