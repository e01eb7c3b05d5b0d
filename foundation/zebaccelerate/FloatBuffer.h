#pragma once

#include "foundation/zebcore/Export.h"

namespace zebaccelerate::utility
{

/// A buffer of count floats, aligned for vector instructions, with undefined content; not null for a count of 0. Null
/// when there is no memory. The caller gives it to Free. [any but process]
ZEB_EXPORT float* Malloc_Float(unsigned int count) noexcept;

/// Null is fine. [any but process]
ZEB_EXPORT void Free(float* buffer) noexcept;

/// Copies count floats. The ranges must not overlap; with a count of 0 the pointers may be null. [any]
ZEB_EXPORT void Copy(unsigned int count, const float* source, float* target) noexcept;

/// Sets count floats to 0. With a count of 0 the pointer may be null. [any]
ZEB_EXPORT void Zero(unsigned int count, float* target) noexcept;

} // namespace zebaccelerate::utility
