// The property list in a preset of an Audio Unit, or in a bundle of one.
#include "fuzz/support/Target.h"
#include "host/src/XAU/src/CFOwner.h"

#include <CoreFoundation/CoreFoundation.h>

#include <cstring>

namespace
{

using namespace zebfuzz;
using namespace zebaudiofilterhost::xau;

CFOwner Parse(const void* bytes, CFIndex size)
{
    const CFOwner data(CFDataCreate(nullptr, static_cast<const UInt8*>(bytes), size));
    return CFOwner(CFPropertyListCreateWithData(nullptr, static_cast<CFDataRef>(data.get()), 0, nullptr, nullptr));
}

CFOwner Print(CFPropertyListRef list)
{
    return CFOwner(CFPropertyListCreateData(nullptr, list, kCFPropertyListBinaryFormat_v1_0, 0, nullptr));
}

void Run(Bytes bytes)
{
    const CFOwner list = Parse(bytes.data(), static_cast<CFIndex>(bytes.size()));
    if (!list)
        return;
    const CFOwner printed = Print(list.get());
    Expect(printed != nullptr, "what is read can be written");
    const auto* data = static_cast<CFDataRef>(printed.get());
    const CFOwner back = Parse(CFDataGetBytePtr(data), CFDataGetLength(data));
    Expect(back != nullptr, "what is written can be read");
    const CFOwner again = Print(back.get());
    Expect(again && CFEqual(again.get(), data) != 0, "and reads as the same");
}

const Target kTarget("xau_property_lists", Run);

} // namespace
