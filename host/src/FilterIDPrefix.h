#pragma once

#include "utility/CommonTypes.h"

namespace zebaudiofilterhost
{

// The technology number and the colon at the start of a filter ID. Older documents hold IDs without them, and a text
// of the prefix alone counts as one without.

/// [any]
inline bool HasTechnologyPrefix(const UTF16String& filterID)
{
    return filterID.size() > 2 && filterID[1] == u':';
}

/// [any]
inline UTF16String WithoutTechnologyPrefix(const UTF16String& filterID)
{
    return HasTechnologyPrefix(filterID) ? filterID.substr(2) : filterID;
}

} // namespace zebaudiofilterhost
