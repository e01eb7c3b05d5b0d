#include "CoreFoundation/CFArray.h"
#include "CoreFoundation/CFData.h"
#include "CoreFoundation/CFDictionary.h"
#include "CoreFoundation/CFNumber.h"
#include "CoreFoundation/CFString.h"
#include "host/src/XAU/linux/src/CFObject.h"
#include "host/src/XAU/linux/src/PropertyListNodes.h"

#include <cstdlib>

namespace zebaudiofilterhost::xau::cf
{

namespace
{

struct FreeBytes
{
    void operator()(void* bytes) const { std::free(bytes); } // NOLINT(cppcoreguidelines-no-malloc): the parser's way
};

template <typename T>
using Bytes = std::unique_ptr<T, FreeBytes>;

CFTypeRef MakeString(plist_t node)
{
    char* text = nullptr;
    plist_get_string_val(node, &text);
    const Bytes<char> owner(text);
    return CFStringCreateWithCString(nullptr, text ? text : "", kCFStringEncodingUTF8);
}

CFTypeRef MakeData(plist_t node)
{
    char* bytes = nullptr;
    std::uint64_t count = 0;
    plist_get_data_val(node, &bytes, &count);
    const Bytes<char> owner(bytes);
    return CFDataCreate(nullptr, reinterpret_cast<const UInt8*>(bytes), static_cast<CFIndex>(count));
}

CFTypeRef MakeInteger(plist_t node)
{
    std::uint64_t value = 0;
    plist_get_uint_val(node, &value);
    const auto integer = static_cast<SInt64>(value);
    return CFNumberCreate(nullptr, kCFNumberSInt64Type, &integer);
}

CFTypeRef MakeReal(plist_t node)
{
    Float64 value = 0;
    plist_get_real_val(node, &value);
    return CFNumberCreate(nullptr, kCFNumberFloat64Type, &value);
}

CFTypeRef MakeBoolean(plist_t node)
{
    std::uint8_t value = 0;
    plist_get_bool_val(node, &value);
    return value != 0 ? kCFBooleanTrue : kCFBooleanFalse;
}

// The parser's fractions of a second have lost their sign, and change with each round.
CFTypeRef MakeDate(plist_t node)
{
    std::int32_t seconds = 0;
    std::int32_t microseconds = 0;
    plist_get_date_val(node, &seconds, &microseconds);
    return CFDateCreate(nullptr, seconds);
}

CFTypeRef MakeArray(plist_t node, int depth)
{
    CFMutableArrayRef array = CFArrayCreateMutable(nullptr, 0, &kCFTypeArrayCallBacks);
    ObjectPtr owner(array);
    plist_array_iter iterator = nullptr; // an item's number would be counted out from the first one on
    plist_array_new_iter(node, &iterator);
    const Bytes<void> iteratorOwner(iterator);
    while (true)
    {
        plist_t value = nullptr;
        plist_array_next_item(node, iterator, &value);
        if (!value)
            return owner.release();
        const ObjectPtr item(MakeObject(value, depth + 1));
        if (!item)
            return nullptr;
        CFArrayAppendValue(array, item.get());
    }
}

CFTypeRef MakeDictionary(plist_t node, int depth)
{
    CFMutableDictionaryRef dictionary =
        CFDictionaryCreateMutable(nullptr, 0, &kCFTypeDictionaryKeyCallBacks, &kCFTypeDictionaryValueCallBacks);
    ObjectPtr owner(dictionary);
    plist_dict_iter iterator = nullptr;
    plist_dict_new_iter(node, &iterator);
    const Bytes<void> iteratorOwner(iterator);
    while (true)
    {
        char* name = nullptr;
        plist_t value = nullptr;
        plist_dict_next_item(node, iterator, &name, &value);
        const Bytes<char> nameOwner(name);
        if (!value)
            return owner.release();
        const ObjectPtr key(CFStringCreateWithCString(nullptr, name, kCFStringEncodingUTF8));
        const ObjectPtr item(MakeObject(value, depth + 1));
        if (!key || !item)
            return nullptr;
        CFDictionarySetValue(dictionary, key.get(), item.get());
    }
}

} // namespace

CFTypeRef MakeObject(plist_t node, int depth)
{
    if (depth > kMaxPropertyListDepth)
        return nullptr;
    switch (plist_get_node_type(node))
    {
    case PLIST_STRING:
        return MakeString(node);
    case PLIST_DATA:
        return MakeData(node);
    case PLIST_UINT:
        return MakeInteger(node);
    case PLIST_REAL:
        return MakeReal(node);
    case PLIST_BOOLEAN:
        return MakeBoolean(node);
    case PLIST_DATE:
        return MakeDate(node);
    case PLIST_ARRAY:
        return MakeArray(node, depth);
    case PLIST_DICT:
        return MakeDictionary(node, depth);
    default:
        return nullptr;
    }
}

} // namespace zebaudiofilterhost::xau::cf
