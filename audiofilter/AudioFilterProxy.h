// A filter that stands in for one whose plug-in is missing.
#pragma once

#include "audiofilter/AudioFilter.h"
#include "audiofilter/GenericParameterInfo.h"

#include <atomic>
#include <deque>
#include <memory>
#include <vector>

namespace zebaudiofilterhost
{

/// Keeps identity, buses, parameter values, settings and channel maps of a filter that can't be made or is put to
/// sleep, does no audio work, and makes the real filter again when the plug-in is back. It reports silence on all
/// outputs. Parameter changes made here never reach the settings: those change by LoadSettings alone.
class ZEB_EXPORT AudioFilterProxy : public AudioFilter
{
public:
    /// For a filter that couldn't be made: `parameterCount` hidden, unnamed parameters of value 0. The application
    /// names them with SetParameterDisplayName and gives the settings that it saved to LoadSettings. There are no
    /// buses: add those that it saved, and set the main target bus and SetUseChannelMap, ahead of
    /// LoadChannelMapSettings. [main]
    AudioFilterProxy(const UTF16String& id, const UTF16String& displayName, unsigned int parameterCount,
                     bool usesChunkData);

    /// For a live filter that is going away; it must not be null and should be suspended. Target buses and names of
    /// parameters stay behind. [main]
    explicit AudioFilterProxy(const boost::intrusive_ptr<AudioFilter>& filter);

    ~AudioFilterProxy() override;

    int GetParameterCount() const override;

    /// Stores the value, so that GetParameter gives it; not part of the settings. An index out of range only counts
    /// as a change. [main when suspended, process while it runs]
    void SetParameter(int index, float value) override;
    float GetParameter(int index) const override;
    boost::intrusive_ptr<AudioFilterParameterInfo> GetParameterInfo(int index) const override;
    bool DoPresetsUseChunkData() const override;

    /// Keeps the preset as it is, whatever its version, type and count; always true. Parameter values do not follow,
    /// no signal fires, and GetParameterDirtyCount stays. [main]
    bool LoadSettings(const PresetData& preset) override;
    void SaveSettings(PresetData& preset) const override;
    bool IsProxy() const override;

    /// Does nothing for an index out of range. [main]
    void SetParameterDisplayName(int index, const UTF16String& name);

    /// The real filter, suspended, with this proxy's settings, maps and, as far as it grants them, buses; null while
    /// the plug-in is missing. Host, target buses and display name are the application's to set. The proxy stays as
    /// it is. Some plug-ins know their latency only when they run, and it may come with the settings: to align what
    /// passes the filter by, call Resume, Suspend, and Resume again. [main]
    boost::intrusive_ptr<AudioFilter> CreateAudioFilterFromZombieState() const;

private:
    bool IsParameter(int index) const;
    void AppendParameter(float value, AudioFilterParameterInfoUnit unit, bool canBeAutomated);

    std::unique_ptr<PropList> mZombieList;
    PresetData mZombiePreset;
    std::vector<boost::intrusive_ptr<GenericParameterInfo>> mParameterInfos;
    std::deque<std::atomic<float>> mParameterValues; // of which none moves
    bool mUsesChunkData;
};

} // namespace zebaudiofilterhost
