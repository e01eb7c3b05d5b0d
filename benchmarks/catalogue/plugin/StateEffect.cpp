#include "benchmarks/catalogue/plugin/StateEffect.h"

#include "benchmarks/catalogue/plugin/StateContent.h"
#include "examples/effects/support/PluginFactory.h"

#include <dlfcn.h>
#include <immintrin.h>

#include <algorithm>
#include <cstdlib>
#include <fstream>
#include <functional>
#include <string>

namespace effects
{

namespace state
{

namespace
{

std::string OwnPath()
{
    static const char sInside = 0;
    Dl_info info{};
    return dladdr(&sInside, &info) != 0 ? info.dli_fname : "";
}

// The IDs follow from the file's name, so that copies under other names are other effects.
FUID MakeID(uint32 kind)
{
    const std::string path = OwnPath();
    const auto name = static_cast<uint32>(std::hash<std::string>()(path.substr(path.rfind('/') + 1)));
    return {0x5A656253, 0x74617465, name, kind};
}

const FUID kProcessorID = MakeID(1);
const FUID kControllerID = MakeID(2);

// Whoever wants to know whether the binary was opened names a file in ZEB_LOAD_LOG.
bool LogLoad()
{
    const char* const log = std::getenv("ZEB_LOAD_LOG");
    if (log != nullptr)
        std::ofstream(log, std::ios::app) << OwnPath() << '\n';
    return log != nullptr;
}

[[maybe_unused]] const bool kLogged = LogLoad();

constexpr unsigned int kNoDenormals = 0x8040;
constexpr int32 kReadSize = 1 << 16;

} // namespace

StateProcessor::StateProcessor()
    : Processor(BusSet({{u"Input", SpeakerArr::kStereo}}, {{u"Output", SpeakerArr::kStereo}}))
{
    const char* const size = std::getenv("ZEB_STATE_BYTES");
    mState = Content(size == nullptr ? 0 : std::strtoul(size, nullptr, 10));
}

tresult PLUGIN_API StateProcessor::getControllerClassId(TUID classID)
{
    kControllerID.toTUID(classID);
    return kResultOk;
}

tresult PLUGIN_API StateProcessor::process(ProcessData& data)
{
    if (data.numInputs > 0 && data.numOutputs > 0)
        for (int32 channel = 0; channel < std::min(data.inputs[0].numChannels, data.outputs[0].numChannels);
             ++channel)
            std::copy_n(data.inputs[0].channelBuffers32[channel], data.numSamples,
                        data.outputs[0].channelBuffers32[channel]);
    _mm_setcsr(_mm_getcsr() | kNoDenormals);
    return kResultOk;
}

tresult PLUGIN_API StateProcessor::setState(IBStream* state)
{
    int64 end = 0;
    if (state->seek(0, IBStream::kIBSeekEnd, &end) != kResultOk ||
        state->seek(0, IBStream::kIBSeekSet, nullptr) != kResultOk)
        return kResultFalse;
    mState.resize(static_cast<std::size_t>(end));
    int32 read = 0;
    for (std::size_t done = 0; done < mState.size(); done += static_cast<std::size_t>(read))
    {
        const auto wanted = static_cast<int32>(std::min<std::size_t>(kReadSize, mState.size() - done));
        if (state->read(mState.data() + done, wanted, &read) != kResultOk || read <= 0)
            return kResultFalse;
    }
    return kResultOk;
}

tresult PLUGIN_API StateProcessor::getState(IBStream* state)
{
    return state->write(mState.data(), static_cast<int32>(mState.size()), nullptr);
}

} // namespace state

PluginDescription DescribePlugin()
{
    return {.vendor = u"Zeb Audio",
            .url = "https://example.org/zeb",
            .email = "effects@example.org",
            .version = u"1.0.0",
            .level = FactoryLevel::kUnicode,
            .classes = {
                {state::kProcessorID, kVstAudioEffectClass, u"State", "Fx|Tools", Make<state::StateProcessor>},
                {state::kControllerID, kVstComponentControllerClass, u"State Controller", "",
                 Make<state::StateController>},
            }};
}

} // namespace effects
