#include "CoreFoundation/CFPropertyList.h"

#include "CoreFoundation/CFData.h"
#include "CoreFoundation/CFStream.h"
#include "host/src/XAU/linux/src/CFStreamObject.h"
#include "host/src/XAU/linux/src/PropertyListGuard.h"
#include "host/src/XAU/linux/src/PropertyListNodes.h"

#include <cstdint>
#include <limits>
#include <span>

using namespace zebaudiofilterhost::xau;

namespace
{

void ClearError(CFErrorRef* error)
{
    if (error)
        *error = nullptr;
}

CFPropertyListRef Parse(std::span<const UInt8> bytes, CFPropertyListFormat* format)
{
    if (!cf::IsSafeToParse(bytes))
        return nullptr;
    const auto* text = reinterpret_cast<const char*>(bytes.data());
    const auto count = static_cast<std::uint32_t>(bytes.size());
    plist_t root = nullptr;
    plist_from_memory(text, count, &root);
    const cf::NodePtr owner(root);
    if (!root)
        return nullptr;
    if (format)
        *format =
            plist_is_binary(text, count) != 0 ? kCFPropertyListBinaryFormat_v1_0 : kCFPropertyListXMLFormat_v1_0;
    return cf::MakeObject(root);
}

CFDataRef Print(CFPropertyListRef list, CFPropertyListFormat format)
{
    const bool isBinary = format == kCFPropertyListBinaryFormat_v1_0;
    const cf::NodePtr root = isBinary || format == kCFPropertyListXMLFormat_v1_0 ? cf::MakeNode(list) : nullptr;
    if (!root)
        return nullptr;
    char* bytes = nullptr;
    std::uint32_t count = 0;
    (isBinary ? plist_to_bin : plist_to_xml)(root.get(), &bytes, &count);
    if (!bytes)
        return nullptr;
    CFDataRef data = CFDataCreate(nullptr, reinterpret_cast<const UInt8*>(bytes), static_cast<CFIndex>(count));
    (isBinary ? plist_to_bin_free : plist_to_xml_free)(bytes);
    return data;
}

} // namespace

CFPropertyListRef CFPropertyListCreateWithData(CFAllocatorRef /*allocator*/, CFDataRef data,
                                               CFOptionFlags /*options*/, CFPropertyListFormat* format,
                                               CFErrorRef* error)
{
    ClearError(error);
    return Parse({CFDataGetBytePtr(data), static_cast<std::size_t>(CFDataGetLength(data))}, format);
}

CFPropertyListRef CFPropertyListCreateWithStream(CFAllocatorRef /*allocator*/, CFReadStreamRef stream, CFIndex count,
                                                 CFOptionFlags /*options*/, CFPropertyListFormat* format,
                                                 CFErrorRef* error)
{
    ClearError(error);
    if (!stream->IsReadable())
        return nullptr;
    const auto all = std::numeric_limits<std::size_t>::max();
    return Parse(stream->Take(count > 0 ? static_cast<std::size_t>(count) : all), format);
}

CFDataRef CFPropertyListCreateData(CFAllocatorRef /*allocator*/, CFPropertyListRef list, CFPropertyListFormat format,
                                   CFOptionFlags /*options*/, CFErrorRef* error)
{
    ClearError(error);
    return Print(list, format);
}

CFIndex CFPropertyListWrite(CFPropertyListRef list, CFWriteStreamRef stream, CFPropertyListFormat format,
                            CFOptionFlags /*options*/, CFErrorRef* error)
{
    ClearError(error);
    CFDataRef data = Print(list, format);
    if (!data)
        return 0;
    const CFIndex written = CFWriteStreamWrite(stream, CFDataGetBytePtr(data), CFDataGetLength(data));
    CFRelease(data);
    return written < 0 ? 0 : written;
}
