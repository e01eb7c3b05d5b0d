#pragma once

#include "foundation/zebcore/PropList.h"

#include <string>

namespace zebfuzz
{

// The content of a property list, told so that two texts are equal exactly if the lists hold the same keys, types and
// bits in the same order. Made without the writer that is tested.
std::string ListText(const zebcore::proplist::PropList& list);

} // namespace zebfuzz
