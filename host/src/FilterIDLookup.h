#pragma once

#include "host/AudioFilterDescriptor.h"
#include "utility/CommonTypes.h"

#include <boost/smart_ptr/intrusive_ptr.hpp>

namespace zebaudiofilterhost
{

// The descriptor of a filter ID, or null. Older documents hold IDs without the technology digit and the colon, so
// the ID is tried as it stands, then as an Audio Unit, then as a VST 2 ID.
boost::intrusive_ptr<AudioFilterDescriptor> FindDescriptorForFilterID(const UTF16String& id);

} // namespace zebaudiofilterhost
