#include "CoreFoundation/CFData.h"

#include "host/src/XAU/linux/src/CFDataObject.h"

#include <algorithm>
#include <functional>
#include <string_view>

using namespace zebaudiofilterhost::xau;

CFHashCode CFOpaqueData::Hash() const
{
    return std::hash<std::string_view>()({reinterpret_cast<const char*>(mBytes.data()), mBytes.size()});
}

CFTypeID CFDataGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::Data);
}

CFDataRef CFDataCreate(CFAllocatorRef /*allocator*/, const UInt8* bytes, CFIndex count)
{
    if (count < 0 || (!bytes && count > 0))
        return nullptr;
    return new CFOpaqueData(count == 0 ? std::vector<UInt8>() : std::vector<UInt8>(bytes, bytes + count));
}

CFMutableDataRef CFDataCreateMutable(CFAllocatorRef /*allocator*/, CFIndex /*capacity*/)
{
    return new CFOpaqueData({});
}

CFIndex CFDataGetLength(CFDataRef data)
{
    return static_cast<CFIndex>(data->mBytes.size());
}

const UInt8* CFDataGetBytePtr(CFDataRef data)
{
    return data->mBytes.data();
}

void CFDataGetBytes(CFDataRef data, CFRange range, UInt8* buffer)
{
    std::copy_n(data->mBytes.begin() + range.location, range.length, buffer);
}

void CFDataAppendBytes(CFMutableDataRef data, const UInt8* bytes, CFIndex count)
{
    data->mBytes.insert(data->mBytes.end(), bytes, bytes + count);
}
