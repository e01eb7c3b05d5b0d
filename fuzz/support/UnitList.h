// Property lists as the component layer of Audio Units reads and writes them.
#pragma once

#include "fuzz/support/Target.h"
#include "host/src/XAU/src/CFOwner.h"

#include <CoreFoundation/CoreFoundation.h>

namespace zebfuzz
{

using zebaudiofilterhost::xau::CFOwner;

// Null if the bytes are no list.
inline CFOwner ParseUnitList(Bytes bytes)
{
    const CFOwner data(CFDataCreate(nullptr, bytes.data(), static_cast<CFIndex>(bytes.size())));
    return CFOwner(CFPropertyListCreateWithData(nullptr, static_cast<CFDataRef>(data.get()), 0, nullptr, nullptr));
}

// In binary form; null if the list cannot be written.
inline CFOwner PrintUnitList(CFPropertyListRef list)
{
    return CFOwner(CFPropertyListCreateData(nullptr, list, kCFPropertyListBinaryFormat_v1_0, 0, nullptr));
}

inline Bytes BytesOf(const CFOwner& data)
{
    const auto* const owned = static_cast<CFDataRef>(data.get());
    return {CFDataGetBytePtr(owned), static_cast<std::size_t>(CFDataGetLength(owned))};
}

// As XML: in binary form the same list has several texts, since an empty value that stands in it twice is written
// once or twice as memory has it.
inline bool AreSameLists(CFPropertyListRef one, CFPropertyListRef other)
{
    const auto print = [](CFPropertyListRef list)
    {
        return CFOwner(CFPropertyListCreateData(nullptr, list, kCFPropertyListXMLFormat_v1_0, 0, nullptr));
    };
    const CFOwner text = print(one);
    const CFOwner otherText = print(other);
    return text && otherText && CFEqual(text.get(), otherText.get()) != 0;
}

} // namespace zebfuzz
