#pragma once

#include "audiofilter/AudioFilter.h"
#include "host/PluginModule.h"
#include "host/PluginModuleInfo.h"
#include "utility/CommonTypes.h"

#include <pluginterfaces/base/ipluginbase.h>

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost::vst3
{

class VST3AudioFilter;

/// One `.vst3` bundle: enters it, holds its factory, lists its audio classes and makes filters from them. [main]
class VST3PluginModule : public PluginModule
{
public:
    explicit VST3PluginModule(const UTF16String& path);
    /// Releases the OS module only: the factory is not released, and the bundle is not told that it ends.
    ~VST3PluginModule() override;

    /// False also when the module is loaded already.
    bool Load() override;
    /// Factory, exit function, OS module, in this order. Nothing in the library calls it: many plug-ins do not
    /// survive being unmapped.
    void Unload() override;

    /// As CreateVST3AudioFilter.
    virtual boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID);
    /// The record of the bundle, and in `filterIDs` its audio classes in factory order. Null, and no IDs, when the
    /// permanent block list names the bundle or the factory has no classes.
    virtual boost::intrusive_ptr<PluginModuleInfo> GetPluginInfo(std::vector<UTF16String>& filterIDs);
    /// Null when the bundle has no such class. A filter whose plug-in did not come up is returned all the same.
    virtual boost::intrusive_ptr<VST3AudioFilter> CreateVST3AudioFilter(const UTF16String& filterID);

private:
    const char16_t* TakeFactory();
    /// Null while the bundle is not loaded.
    Steinberg::IPluginFactory* GetFactory() const;

    Steinberg::IPluginFactory* mFactory = nullptr; // one owned reference, which only Unload releases
};

/// The module of this path, loaded at the first call and kept until the process ends. Null on failure, which is not
/// remembered: the next call tries again. [main]
boost::intrusive_ptr<VST3PluginModule> GetVST3Plugin(const UTF16String& path);

/// The technology's factory function: the filter of a descriptor in the catalogue, or null. [main]
boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID);

} // namespace zebaudiofilterhost::vst3
