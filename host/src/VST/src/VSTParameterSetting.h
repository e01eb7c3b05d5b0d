#pragma once

namespace zebaudiofilterhost::vst
{

class VSTAudioFilter;

/// Lives on the stack around a call of a plug-in's setParameter, which may come back to the host by
/// audioMasterAutomate. Those of a thread are chained up in the order of the calls; other threads don't see them.
class VSTParameterSetting
{
public:
    /// The filter serves as an address alone. [any]
    VSTParameterSetting(const VSTAudioFilter* filter, int index);
    ~VSTParameterSetting();
    VSTParameterSetting(const VSTParameterSetting&) = delete;
    VSTParameterSetting& operator=(const VSTParameterSetting&) = delete;

    /// Whether this thread is inside setParameter of the filter's plug-in for the index. [any]
    static bool IsUnderWay(const VSTAudioFilter* filter, int index);

private:
    const VSTAudioFilter* mFilter;
    int mIndex;
    const VSTParameterSetting* mOuter;
};

} // namespace zebaudiofilterhost::vst
