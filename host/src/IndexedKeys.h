#pragma once

#include "utility/CommonTypes.h"

#include <cstddef>
#include <vector>

namespace zebaudiofilterhost
{

// The name of one entry of a numbered series: the base name followed by the decimal index, without a separator.
UTF8String IndexedKey(const UTF8String& base, std::size_t index);

// The indices from 0 to below `count` under which the list has an entry of the series, ascending. The work is bounded
// by the entries that are there, whatever a damaged file gives as its count.
std::vector<std::size_t> PresentIndices(const PropList& list, const UTF8String& base, int count);

// The same for a series of sub-lists: these themselves, in the order of their indices. They belong to the list.
std::vector<const PropList*> PresentSubLists(const PropList& list, const UTF8String& base, int count);

} // namespace zebaudiofilterhost
