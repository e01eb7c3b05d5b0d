// The chunk of a preset: component size, controller size, both as 64 bits little-endian, then the bytes of both
// states.

#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3MemoryStream.h"

#include <cstdint>
#include <span>

namespace zebaudiofilterhost::vst3
{

using Steinberg::IBStream;
using Steinberg::int32;
using Steinberg::kResultOk;

namespace
{

using Bytes = std::span<const unsigned char>;

constexpr std::size_t kSizeLength = 8;
constexpr std::size_t kHeaderLength = 2 * kSizeLength;

void AppendSize(std::vector<unsigned char>& chunk, std::uint64_t size)
{
    for (std::size_t index = 0; index < kSizeLength; ++index)
        chunk.push_back(static_cast<unsigned char>(size >> (8 * index)));
}

std::uint64_t ReadSize(Bytes bytes)
{
    std::uint64_t size = 0;
    for (std::size_t index = 0; index < kSizeLength; ++index)
        size |= static_cast<std::uint64_t>(bytes[index]) << (8 * index);
    return size;
}

void AppendStream(std::vector<unsigned char>& chunk, const VST3MemoryStream& stream)
{
    if (stream.GetSize() > 0)
        chunk.insert(chunk.end(), stream.GetData(), stream.GetData() + stream.GetSize());
}

struct StateChunk
{
    Bytes component;
    Bytes controller;
};

// False for a chunk that is shorter than it says.
bool ParseChunk(Bytes chunk, StateChunk& state)
{
    if (chunk.size() < kHeaderLength)
        return false;
    const std::uint64_t componentSize = ReadSize(chunk);
    const std::uint64_t controllerSize = ReadSize(chunk.subspan(kSizeLength));
    const Bytes content = chunk.subspan(kHeaderLength);
    if (componentSize > content.size() || controllerSize > content.size() - componentSize)
        return false;
    state.component = content.first(componentSize);
    state.controller = content.subspan(componentSize, controllerSize);
    return true;
}

// False for more than a stream takes.
bool ShowBytes(VST3MemoryStream& stream, Bytes bytes)
{
    if (bytes.size() > static_cast<std::size_t>(VST3MemoryStream::kMaxSize))
        return false;
    // NOLINTNEXTLINE(cppcoreguidelines-pro-type-reinterpret-cast): bytes, under the stream's name for them
    stream.Borrow({reinterpret_cast<const char*>(bytes.data()), bytes.size()});
    return true;
}

// Empty if neither has a state. The streams go before the chunk is put into text: states may have megabytes.
std::vector<unsigned char> CollectChunk(Steinberg::Vst::IComponent& plugin, Steinberg::Vst::IEditController* editor)
{
    VST3MemoryStream component;
    if (plugin.getState(&component) != kResultOk)
        component.SetSize(0);
    VST3MemoryStream controller;
    if (editor != nullptr && editor->getState(&controller) != kResultOk)
        controller.SetSize(0);
    std::vector<unsigned char> chunk;
    if (component.GetSize() == 0 && controller.GetSize() == 0)
        return chunk;
    chunk.reserve(kHeaderLength + static_cast<std::size_t>(component.GetSize() + controller.GetSize()));
    AppendSize(chunk, static_cast<std::uint64_t>(component.GetSize()));
    AppendSize(chunk, static_cast<std::uint64_t>(controller.GetSize()));
    AppendStream(chunk, component);
    AppendStream(chunk, controller);
    return chunk;
}

} // namespace

bool VST3AudioFilter::DoPresetsUseChunkData() const
{
    return true;
}

bool VST3AudioFilter::SaveChunkData(PresetData& presetData) const
{
    if (!mComponent)
        return false;
    const std::vector<unsigned char> chunk = CollectChunk(*mComponent, mController.Get());
    if (chunk.empty())
        return true;
    presetData.SetChunkData(chunk.data(), static_cast<unsigned long>(chunk.size()));
    presetData.SetVersion(GetCurrentPresetVersion());
    presetData.SetPresetType(PresetData::kPresetType_Chunk);
    return true;
}

// Component state, the controller's copy of it, controller state: plug-ins rely on this order. What they answer is
// not looked at, and a chunk whose sizes do not fit it is passed over as a whole.
bool VST3AudioFilter::LoadChunkData(const PresetData& presetData)
{
    std::vector<unsigned char> chunk;
    if (!mComponent || !presetData.GetChunkData(chunk))
        return false;
    StateChunk state;
    VST3MemoryStream component;
    if (!ParseChunk(chunk, state) || !ShowBytes(component, state.component))
        return true;
    mComponent->setState(&component);
    component.seek(0, IBStream::kIBSeekSet, nullptr);
    if (!mController)
        return true;
    mController->setComponentState(&component);
    VST3MemoryStream controller;
    if (!state.controller.empty() && ShowBytes(controller, state.controller))
        mController->setState(&controller);
    return true;
}

} // namespace zebaudiofilterhost::vst3
