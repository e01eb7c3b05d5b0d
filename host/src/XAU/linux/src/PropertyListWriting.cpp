#include "CoreFoundation/CFData.h"
#include "host/src/XAU/linux/src/CFArrayObject.h"
#include "host/src/XAU/linux/src/CFDictionaryObject.h"
#include "host/src/XAU/linux/src/CFNumberObject.h"
#include "host/src/XAU/linux/src/CFStringObject.h"
#include "host/src/XAU/linux/src/PropertyListNodes.h"

#include <cmath>

namespace zebaudiofilterhost::xau::cf
{

namespace
{

NodePtr MakeNumber(const CFOpaqueNumber& number)
{
    if (const auto* integer = std::get_if<SInt64>(&number.mValue))
        return NodePtr(plist_new_uint(static_cast<std::uint64_t>(*integer))); // eight bytes read back with their sign
    return NodePtr(plist_new_real(std::get<Float64>(number.mValue)));
}

NodePtr MakeDate(const CFOpaqueDate& date)
{
    const double seconds = std::trunc(date.mTime);
    if (!(seconds >= INT32_MIN && seconds <= INT32_MAX))
        return nullptr;
    return NodePtr(plist_new_date(static_cast<std::int32_t>(seconds), 0));
}

NodePtr MakeArray(const CFOpaqueArray& array, int depth)
{
    NodePtr node(plist_new_array());
    for (const void* value : array.mValues)
    {
        NodePtr item = MakeNode(value, depth + 1);
        if (!item)
            return nullptr;
        plist_array_append_item(node.get(), item.release());
    }
    return node;
}

NodePtr MakeDictionary(const CFOpaqueDictionary& dictionary, int depth)
{
    NodePtr node(plist_new_dict());
    for (const CFOpaqueDictionary::Entry& entry : dictionary.GetEntries())
    {
        const auto* key = ToType<CFOpaqueString>(entry.key, TypeID::String);
        NodePtr item = key ? MakeNode(entry.value, depth + 1) : nullptr;
        if (!item)
            return nullptr;
        plist_dict_set_item(node.get(), ToUTF8(key).c_str(), item.release());
    }
    return node;
}

NodePtr MakeData(CFDataRef data)
{
    const auto count = static_cast<std::uint64_t>(CFDataGetLength(data));
    static constexpr char kNothing = 0;
    const char* bytes = count == 0 ? &kNothing : reinterpret_cast<const char*>(CFDataGetBytePtr(data));
    return NodePtr(plist_new_data(bytes, count));
}

} // namespace

NodePtr MakeNode(CFTypeRef object, int depth)
{
    if (!object || depth > kMaxPropertyListDepth)
        return nullptr;
    switch (ToObject(object).GetTypeID())
    {
    case TypeID::String:
        return NodePtr(plist_new_string(ToUTF8(static_cast<CFStringRef>(object)).c_str()));
    case TypeID::Number:
        return MakeNumber(*static_cast<CFNumberRef>(object));
    case TypeID::Boolean:
        return NodePtr(plist_new_bool(CFBooleanGetValue(static_cast<CFBooleanRef>(object))));
    case TypeID::Date:
        return MakeDate(*static_cast<CFDateRef>(object));
    case TypeID::Data:
        return MakeData(static_cast<CFDataRef>(object));
    case TypeID::Array:
        return MakeArray(*static_cast<CFArrayRef>(object), depth);
    case TypeID::Dictionary:
        return MakeDictionary(*static_cast<CFDictionaryRef>(object), depth);
    default:
        return nullptr;
    }
}

} // namespace zebaudiofilterhost::xau::cf
