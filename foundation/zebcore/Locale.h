#pragma once

#include "foundation/zebcore/Export.h"

#include <locale>

namespace zebcore
{

class ZEB_EXPORT Locale
{
public:
    /// The locale of all comparisons that fold case: the classic one, whatever the application or a plug-in has made
    /// the global locale. [any]
    static const std::locale& Default();
};

} // namespace zebcore
