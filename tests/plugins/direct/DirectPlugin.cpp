#include "tests/plugins/direct/DirectPlugin.h"

#include "tests/plugins/FixturePaths.h"

#include <dlfcn.h>
#include <stdexcept>

namespace zebtest
{

namespace
{

PClassInfo FindClass(IPluginFactory& factory, const std::string& name)
{
    for (int32 i = 0; i < factory.countClasses(); ++i)
    {
        PClassInfo info;
        if (factory.getClassInfo(i, &info) == kResultOk && FIDStringsEqual(info.category, kVstAudioEffectClass) &&
            (name.empty() || name == info.name))
            return info;
    }
    throw std::runtime_error("no class " + name);
}

} // namespace

IPluginFactory* OpenBundle(const std::filesystem::path& bundle)
{
    void* handle = dlopen(BinaryOf(bundle).c_str(), RTLD_LAZY | RTLD_LOCAL);
    if (handle == nullptr)
        throw std::runtime_error(dlerror());
    if (void* entry = dlsym(handle, "ModuleEntry"))
        reinterpret_cast<bool (*)(void*)>(entry)(handle);
    void* get = dlsym(handle, "GetPluginFactory");
    return get != nullptr ? reinterpret_cast<IPluginFactory* (*)()>(get)() : nullptr;
}

DirectPlugin::DirectPlugin(const std::filesystem::path& bundle, const std::string& className)
    : host(new DirectHost, false)
{
    IPluginFactory* factory = OpenBundle(bundle);
    if (factory == nullptr)
        throw std::runtime_error("no factory");
    const PClassInfo info = FindClass(*factory, className);
    IComponent* made = nullptr;
    if (factory->createInstance(info.cid, IComponent::iid, reinterpret_cast<void**>(&made)) != kResultOk)
        throw std::runtime_error("no component");
    component = IPtr<IComponent>(made, false);
    component->initialize(host->AsUnknown());
    processor = FUnknownPtr<IAudioProcessor>(component);
    MakeController(*factory);
}

void DirectPlugin::MakeController(IPluginFactory& factory)
{
    controller = FUnknownPtr<IEditController>(component);
    TUID id{};
    IEditController* made = nullptr;
    if (controller == nullptr && component->getControllerClassId(id) == kResultOk &&
        factory.createInstance(id, IEditController::iid, reinterpret_cast<void**>(&made)) == kResultOk)
    {
        mSeparate = true;
        controller = IPtr<IEditController>(made, false);
        controller->initialize(host->AsUnknown());
    }
    if (controller != nullptr)
        controller->setComponentHandler(host);
    Connect(true);
}

void DirectPlugin::Connect(bool on)
{
    const FUnknownPtr<IConnectionPoint> one(component);
    const FUnknownPtr<IConnectionPoint> other(controller);
    if (one == nullptr || other == nullptr)
        return;
    on ? one->connect(other) : one->disconnect(other);
    on ? other->connect(one) : other->disconnect(one);
}

DirectPlugin::~DirectPlugin()
{
    if (component == nullptr)
        return;
    Deactivate();
    Connect(false);
    if (controller != nullptr)
        controller->setComponentHandler(nullptr);
    if (mSeparate)
        controller->terminate();
    component->terminate();
}

bool DirectPlugin::Arrange(std::vector<SpeakerArrangement> inputs, std::vector<SpeakerArrangement> outputs)
{
    return processor->setBusArrangements(inputs.data(), static_cast<int32>(inputs.size()), outputs.data(),
                                         static_cast<int32>(outputs.size())) == kResultOk;
}

void DirectPlugin::Activate(double sampleRate, int32 blockSize)
{
    ProcessSetup setup{kRealtime, kSample32, blockSize, sampleRate};
    processor->setupProcessing(setup);
    component->setActive(1);
    processor->setProcessing(1);
    mActive = true;
}

void DirectPlugin::Deactivate()
{
    if (!mActive)
        return;
    mActive = false;
    processor->setProcessing(0);
    component->setActive(0);
}

// The channels grow to what the buses want.
std::vector<AudioBusBuffers> DirectPlugin::Buffers(BusDirection direction, Channels& channels,
                                                   std::vector<float*>& pointers)
{
    std::vector<AudioBusBuffers> buffers(static_cast<std::size_t>(component->getBusCount(kAudio, direction)));
    std::size_t total = 0;
    for (std::size_t i = 0; i < buffers.size(); ++i)
    {
        SpeakerArrangement arrangement = 0;
        processor->getBusArrangement(direction, static_cast<int32>(i), arrangement);
        buffers[i].numChannels = __builtin_popcountll(arrangement);
        total += static_cast<std::size_t>(buffers[i].numChannels);
    }
    const std::size_t length = channels.empty() ? 0 : channels.front().size();
    channels.resize(total, std::vector<float>(length));
    for (auto& channel : channels)
        pointers.push_back(channel.data());
    std::size_t first = 0;
    for (AudioBusBuffers& buffer : buffers)
    {
        buffer.channelBuffers32 = pointers.data() + first;
        first += static_cast<std::size_t>(buffer.numChannels);
    }
    return buffers;
}

Channels DirectPlugin::Process(const Channels& input, const std::vector<Point>& points, uint64 silence)
{
    Channels in = input;
    Channels out(1, std::vector<float>(input.empty() ? 0 : input.front().size(), 99.0F)); // not silence by accident
    std::vector<float*> inPointers;
    std::vector<float*> outPointers;
    const auto length = static_cast<int32>(out.front().size());
    auto inputs = Buffers(kInput, in, inPointers);
    auto outputs = Buffers(kOutput, out, outPointers);
    if (!inputs.empty())
        inputs.front().silenceFlags = silence;
    DirectChanges changes;
    DirectChanges written;
    for (const Point& point : points)
        changes.Add(point);

    ProcessData data;
    data.numSamples = length;
    data.numInputs = static_cast<int32>(inputs.size());
    data.numOutputs = static_cast<int32>(outputs.size());
    data.inputs = inputs.data();
    data.outputs = outputs.data();
    data.inputParameterChanges = &changes;
    data.outputParameterChanges = &written;
    processor->process(data);
    outputPoints = written.Points();
    outputSilence = outputs.empty() ? 0 : outputs.front().silenceFlags;
    return out;
}

std::u16string DirectPlugin::Text(ParamID id, double normalized)
{
    String128 text{};
    controller->getParamStringByValue(id, normalized, text);
    return text;
}

double DirectPlugin::Value(ParamID id, std::u16string text)
{
    ParamValue value = -1.0;
    return controller->getParamValueByString(id, text.data(), value) == kResultOk ? value : -1.0;
}

std::string DirectPlugin::State()
{
    DirectStream stream;
    component->getState(&stream);
    return stream.bytes;
}

tresult DirectPlugin::SetState(const std::string& bytes)
{
    DirectStream stream;
    stream.bytes = bytes;
    return component->setState(&stream);
}

} // namespace zebtest
