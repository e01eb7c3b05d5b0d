#include "output/Tracing.h"

#include <foundation/zebcore/Trace.h>

namespace zebhost
{

void StartTracing(const std::vector<std::string>& categories)
{
    for (const std::string& category : categories)
    {
        if (category == "all")
        {
            zebcore::debug::SetAllTraceEnabled(true);
        }
        else
        {
            zebcore::debug::SetTraceCategoryEnabled(category, true);
        }
    }
}

} // namespace zebhost
