#pragma once

#include "utility/CommonTypes.h"

namespace soak
{

/// Enters into the catalogue a built-in filter with parameters, a state and a latency: what it loses can be nobody's
/// but the library's. To be called ahead of Initialize. [main]
void RegisterControlFilter();

inline const zebaudiofilterhost::UTF16String kControlFilterID = u"1:soak-control";

} // namespace soak
