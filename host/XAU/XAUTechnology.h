#pragma once

#include "foundation/zebcore/Export.h"
#include "utility/CommonTypes.h"

namespace zebaudiofilterhost::xau
{

// The GUID under which AudioFilterFactory knows all Audio Units. [any]
ZEB_EXPORT Guid GetXAUFactoryGuid();

} // namespace zebaudiofilterhost::xau
