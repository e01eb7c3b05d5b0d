#pragma once

#include "AudioToolbox/AudioComponent.h"
#include "utility/CommonTypes.h"

#include <string>
#include <vector>

namespace zebaudiofilterhost::xau
{

/// What a bundle says of one of its components.
struct ComponentListing
{
    AudioComponentDescription description = {};
    UTF16String name;
    UInt32 version = 0;
    UTF16String bundle;  // path
    std::string factory; // exported function
};

/// The components of one bundle, in the order of its Info.plist. One whose entry is not complete is left out
/// and traced ("ComponentBundle"), with the key at fault; a bundle without a readable Info.plist has none. Nothing is
/// loaded. [main]
std::vector<ComponentListing> ReadComponentBundle(const UTF16String& path);

/// Paths of the bundles that $AUDIO_COMPONENT_BUNDLES lists, then of those in the folders of components and below
/// them, in a fixed order. [main]
std::vector<UTF16String> FindComponentBundles();

} // namespace zebaudiofilterhost::xau
