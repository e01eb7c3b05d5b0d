#pragma once

#include "AudioToolbox/AudioComponent.h"
#include "foundation/zebcore/OSModule.h"
#include "host/src/XAU/linux/src/ComponentBundle.h"

#include <cstddef>
#include <map>
#include <memory>
#include <vector>

/// One component: registered by the process, or listed by a bundle that is loaded when an instance is first asked
/// for.
struct OpaqueAudioComponent
{
    /// Null if the bundle cannot be loaded or lacks the function.
    AudioComponentFactoryFunction GetFactory();

    zebaudiofilterhost::xau::ComponentListing mListing;
    std::size_t mIndex = 0; // in the registry
    AudioComponentFactoryFunction mFactory = nullptr;
};

namespace zebaudiofilterhost::xau
{

/// All components known so far, in the order in which they became known. Never destroyed. [main]
class ComponentRegistry
{
public:
    static ComponentRegistry& GetInstance();

    /// Reads the bundles that have come since the last time.
    void Update();

    /// Null at the end. `after` may be null.
    AudioComponent FindNext(AudioComponent after, const AudioComponentDescription& description) const;

    /// Null unless that very type, subtype and manufacturer is known.
    AudioComponent Find(const AudioComponentDescription& description) const;
    AudioComponent Add(ComponentListing listing, AudioComponentFactoryFunction factory);

    /// Null if it cannot be loaded. It stays loaded.
    zebcore::utility::OSModuleRef LoadBundle(const UTF16String& path);

private:
    std::vector<std::unique_ptr<OpaqueAudioComponent>> mComponents;
    std::map<UTF16String, zebcore::utility::OSModuleRef> mBundles; // null until loaded
};

} // namespace zebaudiofilterhost::xau
