#include "foundation/zebcore/Locale.h"

namespace zebcore
{

const std::locale& Locale::Default()
{
    return std::locale::classic();
}

} // namespace zebcore
