// The chunk of a preset: component size, controller size, both as 64 bits little-endian, then the bytes of both
// states.

#include "host/src/VST3/src/VST3AudioFilter.h"
#include "host/src/VST3/src/VST3MemoryStream.h"

#include <algorithm>
#include <cstdint>
#include <optional>
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

// Takes so many bytes off the front of `rest`, or what there is.
Bytes Take(Bytes& rest, std::size_t count)
{
    const Bytes taken = rest.first(std::min(count, rest.size()));
    rest = rest.subspan(taken.size());
    return taken;
}

// What is missing of it counts as 0.
std::uint64_t TakeSize(Bytes& rest)
{
    std::uint64_t size = 0;
    int shift = 0;
    for (const unsigned char byte : Take(rest, kSizeLength))
    {
        size |= static_cast<std::uint64_t>(byte) << shift;
        shift += 8;
    }
    return size;
}

// A state of this size; none if it is not there as a whole. Streams count in 32 bits, and so does this.
std::optional<Bytes> TakeState(Bytes& rest, std::uint64_t size)
{
    const auto count = static_cast<std::int32_t>(static_cast<std::uint32_t>(size));
    if (count < 0)
        return std::nullopt;
    const Bytes state = Take(rest, static_cast<std::size_t>(count));
    const bool isWhole = state.size() == static_cast<std::size_t>(count) && count <= VST3MemoryStream::kMaxSize;
    return isWhole ? std::optional(state) : std::nullopt;
}

void AppendStream(std::vector<unsigned char>& chunk, const VST3MemoryStream& stream)
{
    if (stream.GetSize() > 0)
        chunk.insert(chunk.end(), stream.GetData(), stream.GetData() + stream.GetSize());
}

void ShowBytes(VST3MemoryStream& stream, Bytes bytes)
{
    // NOLINTNEXTLINE(cppcoreguidelines-pro-type-reinterpret-cast): bytes, under the stream's name for them
    stream.Borrow({reinterpret_cast<const char*>(bytes.data()), bytes.size()});
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
// not looked at. Of a chunk that was cut short, the states that are whole come back.
bool VST3AudioFilter::LoadChunkData(const PresetData& presetData)
{
    std::vector<unsigned char> chunk;
    if (!mComponent || !presetData.GetChunkData(chunk))
        return false;
    Bytes rest = chunk;
    const std::uint64_t componentSize = TakeSize(rest);
    const std::uint64_t controllerSize = TakeSize(rest);
    const std::optional<Bytes> componentState = TakeState(rest, componentSize);
    if (componentState)
    {
        VST3MemoryStream stream;
        ShowBytes(stream, *componentState);
        mInputTransfer.Discard(); // what waits is older than this state
        mComponent->setState(&stream);
        stream.seek(0, IBStream::kIBSeekSet, nullptr);
        if (mController)
            mController->setComponentState(&stream);
    }
    const std::optional<Bytes> controllerState = TakeState(rest, controllerSize);
    if (mController && controllerSize != 0 && controllerState)
    {
        VST3MemoryStream stream;
        ShowBytes(stream, *controllerState);
        mController->setState(&stream);
    }
    return true;
}

} // namespace zebaudiofilterhost::vst3
