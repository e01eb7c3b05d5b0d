#pragma once

#include "audiofilter/AudioFilter.h"
#include "host/PluginModule.h"
#include "host/PluginModuleInfo.h"
#include "host/src/VST/interface/VST2Interface.h"
#include "utility/CommonTypes.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost::vst
{

class VSTAudioFilter;

/// One VST 2 binary, a `.vst` bundle or what else the system has: finds its entry point, lists its effects and makes
/// filters from them. [main]
class VSTPluginModule : public PluginModule
{
public:
    explicit VSTPluginModule(const UTF16String& path);
    ~VSTPluginModule() override;

    /// False also when the module is loaded already.
    bool Load() override;
    /// The entry point stays as it is. Nothing in the library calls it: many plug-ins do not survive being unmapped.
    void Unload() override;

    /// An instance of the binary's effect, or of the shell's member with this ID. Null when the plug-in gives none.
    virtual boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID);
    /// The record of the binary, and in `filterIDs` its effects: a shell's members, one for an effect, none for an
    /// instrument. Null, and no IDs, when the binary gives no VST 2 plug-in or one older than 2.3, or when the
    /// permanent block list names an effect. What the plug-in throws when it is asked for version, category or
    /// members passes through.
    virtual boost::intrusive_ptr<PluginModuleInfo> GetPluginInfo(std::vector<UTF16String>& filterIDs);

private:
    bool FindEntryPoint();
    /// A new instance, not opened yet; null if the plug-in refuses. `uniqueID` is what it is told when it asks which
    /// member of a shell to make.
    AEffect* MakeEffect(unsigned int uniqueID) const;

    boost::intrusive_ptr<PluginModuleInfo> DescribeEffect(AEffect* effect, std::vector<UTF16String>& filterIDs);
    /// For GetLoadProblem: the end of a sentence that the path begins; an empty one forgets the last.
    void SetProblem(const UTF16String& ending) const;

    VSTPluginMainProc mEntryPoint = nullptr;
    bool mIsShell = false; // known when GetPluginInfo has run
};

/// The module of this path, loaded at the first call and kept until the process ends. Null on failure, which is not
/// remembered: the next call tries again. [main]
boost::intrusive_ptr<VSTPluginModule> GetVSTPlugin(const UTF16String& path);

/// The technology's factory function: the filter of a descriptor in the catalogue, under the name that the catalogue
/// has for it, or null. IDs without "2:" count too. [main]
boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID);

} // namespace zebaudiofilterhost::vst
