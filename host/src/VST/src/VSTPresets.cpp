// Programs and chunks of a plug-in as presets of its filter.

#include "foundation/zebcore/StringConversion.h"
#include "host/src/VST/src/VSTAudioFilter.h"
#include "host/src/VST/src/VSTText.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <limits>

namespace zebaudiofilterhost::vst
{

namespace
{

// As index of the chunk opcodes: the current program's chunk, not that of the whole bank.
constexpr int kProgramChunk = 1;

constexpr std::size_t kProgramNameSize = 73;

// Sizes are 32-bit numbers in most plug-ins; a larger one is garbage.
constexpr long long kMaxChunkSize = std::numeric_limits<std::int32_t>::max();

// Programs beyond these are a lie of the plug-in's.
constexpr int kMaxPrograms = 32768;

} // namespace

bool VSTAudioFilter::DoPresetsUseChunkData() const
{
    return GetEffect() != nullptr && (GetEffect()->flags & effFlagsProgramChunks) != 0;
}

int VSTAudioFilter::GetNumFactoryPresets() const
{
    return GetEffect() ? std::clamp(GetEffect()->numPrograms, 0, kMaxPrograms) : 0;
}

UTF16String VSTAudioFilter::GetFactoryPresetName(int index) const
{
    if (index < 0 || index >= GetNumFactoryPresets())
        return {};
    std::array<char, kProgramNameSize> name = {};
    Dispatcher(effGetProgramNameIndexed, index, 0, name.data(), 0.0F);
    name.back() = '\0';
    return zebcore::utility::UTF16FromNarrow(BoundedText(name));
}

// The plug-in always stays in program 0, which takes over the state of the program asked for. Asking for program 0 is
// deliberately nothing: it is there already.
void VSTAudioFilter::SetFactoryPreset(int index)
{
    if (index <= 0 || index >= GetNumFactoryPresets())
        return;
    PropList state;
    PresetData preset(state);
    Dispatcher(effSetProgram, 0, index, nullptr, 0.0F);
    SaveSettings(preset);
    Dispatcher(effSetProgram, 0, 0, nullptr, 0.0F);
    LoadSettings(preset);
}

// The first is the plug-in's present state, the others are references.
void VSTAudioFilter::GetFactoryDefaultPresets(PresetList& list) const
{
    list.Clear();
    for (int index = 0; index < GetNumFactoryPresets(); ++index)
    {
        const UTF16String name = GetFactoryPresetName(index);
        const auto preset = name.empty() ? nullptr : list.AppendPreset(name);
        if (!preset)
            continue;
        if (index == 0)
        {
            SaveSettings(*preset);
            continue;
        }
        preset->SetVersion(GetCurrentPresetVersion());
        preset->SetPresetType(PresetData::kPresetType_Factory);
        preset->SetFactoryPresetName(name);
        preset->SetFactoryIndex(index);
    }
}

bool VSTAudioFilter::LoadChunkData(const PresetData& preset)
{
    std::vector<unsigned char> chunk;
    if (!DoPresetsUseChunkData() || !preset.GetChunkData(chunk))
        return false;
    Dispatcher(effSetChunk, kProgramChunk, static_cast<long long>(chunk.size()), chunk.data(), 0.0F);
    return true;
}

bool VSTAudioFilter::SaveChunkData(PresetData& preset) const
{
    if (!DoPresetsUseChunkData())
        return false;
    const unsigned char* chunk = nullptr; // the plug-in's memory
    const long long size = Dispatcher(effGetChunk, kProgramChunk, 0, &chunk, 0.0F);
    const bool isLie = chunk != nullptr && (size < 0 || size > kMaxChunkSize);
    // Bytes that are said to be there without memory are no chunk: the preset keeps the one that it has.
    preset.SetChunkData(chunk, isLie ? 0 : static_cast<unsigned long>(size));
    preset.SetVersion(GetCurrentPresetVersion());
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    return true;
}

} // namespace zebaudiofilterhost::vst
