// Settings in and out of presets.
#include "audiofilter/AudioFilter.h"

#include <algorithm>

namespace zebaudiofilterhost
{

bool AudioFilter::LoadSettings(const PresetData& preset)
{
    StartLoadingSettings();
    // Also after a refusal or a throw, so that the application shows what stands now.
    const auto finish = [this]
    {
        FinishLoadingSettings(true);
        BumpParameterDirtyCount();
    };
    bool loaded = false;
    try
    {
        loaded = ValidatePresetVersion(preset.GetVersion()) && LoadByType(preset);
    }
    catch (...)
    {
        finish();
        throw;
    }
    finish();
    return loaded;
}

bool AudioFilter::LoadByType(const PresetData& preset)
{
    switch (preset.GetPresetType())
    {
    case PresetData::kPresetType_Params:
        return !DoPresetsUseChunkData() && LoadParams(preset);
    case PresetData::kPresetType_Chunk:
        if (!DoPresetsUseChunkData())
            return false;
        LoadChunkData(preset);
        return true; // Whatever the plug-in made of the chunk
    case PresetData::kPresetType_Factory:
        return LoadFactoryPreset(preset);
    case PresetData::kPresetType_Custom:
        return LoadCustomData(preset);
    }
    return false;
}

bool AudioFilter::LoadFactoryPreset(const PresetData& preset)
{
    const UTF16String name = preset.GetFactoryPresetName();
    const int index = preset.GetFactoryIndex();
    if (index >= 0 && GetFactoryPresetName(index) == name)
    {
        SetFactoryPreset(index);
        return true;
    }
    // Presets may have been renumbered. Of several with the same name the last one wins.
    bool found = false;
    for (int i = 0; i < GetNumFactoryPresets(); ++i)
    {
        if (GetFactoryPresetName(i) == name)
        {
            SetFactoryPreset(i);
            found = true;
        }
    }
    return found;
}

void AudioFilter::SaveSettings(PresetData& preset) const
{
    preset.Clear();
    if (DoPresetsUseChunkData())
    {
        SaveChunkData(preset);
        return;
    }
    std::list<float> params;
    SaveParams(params);
    preset.SetVersion(GetCurrentPresetVersion());
    preset.SetPresetType(PresetData::kPresetType_Params);
    preset.SetParamList(params);
}

bool AudioFilter::LoadChunkData(const PresetData&)
{
    return false;
}

bool AudioFilter::SaveChunkData(PresetData& preset) const
{
    preset.SetVersion(GetCurrentPresetVersion());
    preset.SetPresetType(PresetData::kPresetType_Chunk);
    return true;
}

bool AudioFilter::LoadCustomData(const PresetData&)
{
    return false;
}

bool AudioFilter::LoadParams(const PresetData& preset)
{
    std::list<float> params;
    preset.GetParamList(params);
    if (!ValidateParamCount(static_cast<int>(params.size())))
        return false;
    int index = 0;
    for (const float value : params)
        SetParameterAutomated(index++, value);
    return true;
}

void AudioFilter::SaveParams(std::list<float>& params) const
{
    std::list<float> values(static_cast<std::size_t>(std::max(GetParameterCount(), 0)));
    int index = 0;
    for (float& value : values)
        value = GetParameter(index++);
    params.swap(values);
}

bool AudioFilter::ValidatePresetVersion(float version) const
{
    return version == GetCurrentPresetVersion();
}

bool AudioFilter::ValidateParamCount(int count) const
{
    return count == GetParameterCount();
}

float AudioFilter::GetCurrentPresetVersion() const
{
    return 1.0F;
}

bool AudioFilter::DoPresetsUseChunkData() const
{
    return false;
}

void AudioFilter::GetFactoryDefaultPresets(PresetList& list) const
{
    list.Clear();
    for (int i = 0; i < GetNumFactoryPresets(); ++i)
    {
        const UTF16String name = GetFactoryPresetName(i);
        if (name.empty())
            continue;
        const boost::intrusive_ptr<PresetData> preset = list.AppendPreset(name);
        if (!preset) // A name that was there already
            continue;
        preset->SetVersion(GetCurrentPresetVersion());
        preset->SetPresetType(PresetData::kPresetType_Factory);
        preset->SetFactoryPresetName(name);
    }
}

int AudioFilter::GetNumFactoryPresets() const
{
    return 0;
}

UTF16String AudioFilter::GetFactoryPresetName(int) const
{
    return {};
}

void AudioFilter::SetFactoryPreset(int)
{
}

bool AudioFilter::ArePresetsSafeForPlayback() const
{
    return true;
}

void AudioFilter::StartLoadingSettings()
{
    mLoadingSettings.store(true, std::memory_order_relaxed);
}

void AudioFilter::FinishLoadingSettings(bool)
{
    mLoadingSettings.store(false, std::memory_order_relaxed);
    mPresetChangedSignal();
}

} // namespace zebaudiofilterhost
