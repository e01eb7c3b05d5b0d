#pragma once

#include "foundation/zebcore/Export.h"

namespace zebaudiodsp
{

/// The usual functions, in the precision of their argument. [any]
ZEB_EXPORT float expf(float value) noexcept;
ZEB_EXPORT float logf(float value) noexcept;
ZEB_EXPORT double atan(double value) noexcept;

} // namespace zebaudiodsp
