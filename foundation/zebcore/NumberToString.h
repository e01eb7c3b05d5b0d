#pragma once

#include "foundation/zebcore/Export.h"
#include "foundation/zebcore/Flags.h"
#include "foundation/zebcore/StringTypes.h"

namespace zebcore::utility
{

/// Decimal text of the value with a point and the given number of decimals (at most 100 are written), the same in
/// every locale. Never in exponent form; a value that rounds to zero has no sign. Infinities and NaN read "inf",
/// "-inf" and "nan".
///
/// integerDigits and maximumLength are what the caller expects the text to need. They neither pad nor cut it: a
/// number is worth more whole than aligned. No format flag is defined. [any]
ZEB_EXPORT UTF16String NumberToString(double value, unsigned long integerDigits, unsigned long decimals,
                                      Flags<unsigned short> flags, int maximumLength);

} // namespace zebcore::utility
