#pragma once

#include "host/PluginLocator.h"
#include "host/PluginScanContext.h"
#include "utility/CommonTypes.h"

#include <AudioToolbox/AudioToolbox.h>

#include <boost/smart_ptr/intrusive_ptr.hpp>

#include <vector>

namespace zebaudiofilterhost
{

class AudioFilter;

} // namespace zebaudiofilterhost

namespace zebaudiofilterhost::xau
{

// What the catalogue is given of Audio Units. They are found through the system's registry and not in directories.
// All operations: [main]

/// Effects that fit the description and are not blocked.
std::vector<PluginLocator> FindComponents(const AudioComponentDescription& description);

/// All effects, mixers twice; none if the debug setting "EnableAUSupport" is false.
std::vector<PluginLocator> GetPotentialPluginLocators();

/// One text that says that there are none.
std::vector<UTF16String> GetDefaultAUPluginDirectories();

/// The component's full name, or the ID where it is not installed.
UTF16String GetPathDisplayString(const UTF16String& id);

boost::intrusive_ptr<PluginScanContext> CreateScanContext(const std::vector<Dir>& directories);

/// Null on failure.
boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const UTF16String& filterID);

} // namespace zebaudiofilterhost::xau
