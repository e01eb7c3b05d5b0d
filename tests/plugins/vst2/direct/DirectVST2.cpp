#include "tests/plugins/vst2/direct/DirectVST2.h"

#include "tests/plugins/FixturePaths.h"

#include <dlfcn.h>
#include <stdexcept>

namespace zebtest
{

using namespace zebaudiofilterhost::vst;

namespace
{

std::int32_t sWantedMember = 0;

VSTPluginMainProc EntryOf(const std::filesystem::path& path)
{
    const std::filesystem::path binary = BinaryOf(path);
    void* handle = dlopen(binary.c_str(), RTLD_LAZY | RTLD_LOCAL);
    if (handle == nullptr)
        throw std::runtime_error(dlerror());
    for (const char* name : {"VSTPluginMain", "main_macho", "main"})
        if (void* entry = dlsym(handle, name))
            return reinterpret_cast<VSTPluginMainProc>(entry);
    throw std::runtime_error("no entry point in " + binary.string());
}

std::vector<float*> Pointers(VST2Channels& channels)
{
    std::vector<float*> pointers;
    for (auto& channel : channels)
        pointers.push_back(channel.data());
    return pointers;
}

} // namespace

DirectVST2::DirectVST2(const std::filesystem::path& path, std::int32_t member)
{
    sWantedMember = member;
    effect = EntryOf(path)(HostCallback);
    if (effect == nullptr)
        return;
    effect->user = this;
    Call(effOpen);
}

DirectVST2::~DirectVST2()
{
    if (effect == nullptr)
        return;
    Call(effMainsChanged);
    Call(effClose);
}

long long DirectVST2::HostCallback(AEffect* effect, std::int32_t opcode, std::int32_t index, long long value, void*,
                                   float opt)
{
    if (opcode == audioMasterVersion)
        return 2400;
    if (opcode == audioMasterCurrentId)
        return sWantedMember;
    if (effect == nullptr || effect->user == nullptr)
        return 0;
    return static_cast<DirectVST2*>(effect->user)->Answer(opcode, index, value, opt);
}

long long DirectVST2::Answer(std::int32_t opcode, std::int32_t index, long long value, float opt)
{
    switch (opcode)
    {
    case audioMasterAutomate:
        told.push_back("automate " + std::to_string(index));
        lastValue = opt;
        return 0;
    case audioMasterBeginEdit:
        told.push_back("begin " + std::to_string(index));
        return 1;
    case audioMasterEndEdit:
        told.push_back("end " + std::to_string(index));
        return 1;
    case audioMasterSizeWindow:
        told.push_back("size " + std::to_string(index) + ' ' + std::to_string(value));
        return canResize ? 1 : 0;
    default:
        return 0;
    }
}

long long DirectVST2::Call(std::int32_t opcode, std::int32_t index, long long value, void* ptr, float opt)
{
    return effect->dispatcher(effect, opcode, index, value, ptr, opt);
}

std::string DirectVST2::Text(std::int32_t opcode, std::int32_t index)
{
    std::string text(256, '\0');
    Call(opcode, index, 0, text.data());
    return text.substr(0, text.find('\0'));
}

bool DirectVST2::Arrange(std::int32_t type, std::int32_t channels)
{
    VstSpeakerArrangement arrangement{};
    arrangement.type = type;
    arrangement.numChannels = channels;
    return Call(effSetSpeakerArrangement, 0, reinterpret_cast<long long>(&arrangement), &arrangement) != 0;
}

std::string DirectVST2::Chunk(bool ofProgram)
{
    void* bytes = nullptr;
    const long long size = Call(effGetChunk, ofProgram ? 1 : 0, 0, &bytes);
    return {static_cast<const char*>(bytes), static_cast<std::size_t>(size)};
}

bool DirectVST2::SetChunk(bool ofProgram, std::string bytes)
{
    return Call(effSetChunk, ofProgram ? 1 : 0, static_cast<long long>(bytes.size()), bytes.data()) != 0;
}

void DirectVST2::Resume(float sampleRate, int blockSize)
{
    Call(effSetSampleRate, 0, 0, nullptr, sampleRate);
    Call(effSetBlockSize, 0, blockSize);
    Call(effMainsChanged, 0, 1);
    Call(effStartProcess);
}

VST2Channels DirectVST2::Process(VST2Channels input)
{
    const std::size_t frames = input.empty() ? 0 : input.front().size();
    input.resize(static_cast<std::size_t>(effect->numInputs), std::vector<float>(frames));
    // Not silence by accident.
    VST2Channels output(static_cast<std::size_t>(effect->numOutputs), std::vector<float>(frames, 99.0F));
    effect->processReplacing(effect, Pointers(input).data(), Pointers(output).data(),
                             static_cast<std::int32_t>(frames));
    return output;
}

} // namespace zebtest
