#include "host/src/XAU/linux/src/PropertyListGuard.h"

#include "host/src/XAU/linux/src/BinaryListGuard.h"
#include "host/src/XAU/linux/src/XMLListGuard.h"

#include <algorithm>
#include <string_view>

namespace zebaudiofilterhost::xau::cf
{

bool IsSafeToParse(std::span<const UInt8> bytes)
{
    if (bytes.empty() || bytes.size() > kMaxPropertyListSize)
        return false;
    if (BinaryListGuard::IsBinary(bytes))
        return BinaryListGuard(bytes).IsSafe();
    if (std::find(bytes.begin(), bytes.end(), 0) != bytes.end())
        return false;
    return XMLListGuard({reinterpret_cast<const char*>(bytes.data()), bytes.size()}).IsSafe();
}

} // namespace zebaudiofilterhost::xau::cf
