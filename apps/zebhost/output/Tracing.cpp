#include "output/Tracing.h"

#include <foundation/zebcore/Trace.h>

#include <algorithm>

namespace zebhost
{

namespace
{

constexpr const char* kAll = "all";

std::vector<std::string>& Wanted()
{
    static std::vector<std::string> sWanted;
    return sWanted;
}

} // namespace

void StartTracing(const std::vector<std::string>& categories)
{
    Wanted() = categories;
    for (const std::string& category : categories)
    {
        if (category == kAll)
        {
            zebcore::debug::SetAllTraceEnabled(true);
        }
        else
        {
            zebcore::debug::SetTraceCategoryEnabled(category, true);
        }
    }
}

bool IsTracing(std::string_view category)
{
    return std::any_of(Wanted().begin(), Wanted().end(),
                       [category](const std::string& wanted) { return wanted == kAll || wanted == category; });
}

} // namespace zebhost
