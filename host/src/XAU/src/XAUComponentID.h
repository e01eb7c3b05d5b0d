#pragma once

#include "utility/CommonTypes.h"

#include <AudioToolbox/AudioToolbox.h>

namespace zebaudiofilterhost::xau
{

/// The text under which settings, presets and the catalogue know a unit: type, subtype and manufacturer of its
/// description, each in decimal, with a blank between. [any]
UTF16String EncodeComponentID(const AudioComponentDescription& description);

/// Every text gives some description: what cannot be read of it is 0, and a prefix of two units is optional. [any]
AudioComponentDescription DecodeComponentID(const UTF16String& id);

/// The first match; null if there is none. [main]
AudioComponent FindComponentForDescription(const AudioComponentDescription& description);

/// From the component's full name, "Vendor: Name". Both outputs stay as they are if there is no such name. [main]
void GetNameAndManufacturer(AudioComponent component, UTF16String& name, UTF16String& vendor);

} // namespace zebaudiofilterhost::xau
