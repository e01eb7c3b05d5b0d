#include "host/src/XAU/linux/src/PropertyListGuard.h"

#include "host/src/XAU/linux/src/BinaryListGuard.h"
#include "host/src/XAU/linux/src/XMLListGuard.h"

#include <algorithm>
#include <cstdint>
#include <limits>
#include <string_view>

namespace zebaudiofilterhost::xau::cf
{

bool IsSafeToParse(std::span<const UInt8> bytes)
{
    if (bytes.empty() || bytes.size() > std::numeric_limits<std::uint32_t>::max()) // the parser's count
        return false;
    if (BinaryListGuard::IsBinary(bytes))
        return BinaryListGuard(bytes).IsSafe();
    if (bytes.size() > kMaxPropertyListSize || std::find(bytes.begin(), bytes.end(), 0) != bytes.end())
        return false;
    return XMLListGuard({reinterpret_cast<const char*>(bytes.data()), bytes.size()}).IsSafe();
}

} // namespace zebaudiofilterhost::xau::cf
