// Making filters from their identifiers.
#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/StringTypes.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

namespace zebaudiofilterhost
{

class AudioFilter;

namespace utility
{

/// Makes the filter of an identifier, suspended. An identifier without its technology digit, or with an older name of
/// the plug-in behind its number, is found too. Null if the catalogue does not know the filter, if it or its plug-in
/// is disabled, or if the plug-in cannot be loaded. A VST 3 plug-in that loads but refuses to come up still gives a
/// filter, which has no buses and never processes. What a plug-in throws while it is made may pass through. Include
/// "audiofilter/AudioFilter.h" to hold the result. [main]
ZEB_EXPORT boost::intrusive_ptr<AudioFilter> CreateAudioFilter(const zebcore::UTF16String& id);

} // namespace utility
} // namespace zebaudiofilterhost
