#pragma once

#include "host/src/XAU/src/CFOwner.h"

#include <AudioToolbox/AudioToolbox.h>

#include <string>
#include <string_view>

namespace zebaudiofilterhost::xau
{

// Each with one reference, for the caller.
inline CFStringRef MakeString(const char* text)
{
    return CFStringCreateWithCString(nullptr, text, kCFStringEncodingUTF8);
}

template <typename T>
CFNumberRef MakeNumber(CFNumberType type, T value)
{
    return CFNumberCreate(nullptr, type, &value);
}

inline CFDataRef MakeBytes(std::string_view bytes)
{
    return CFDataCreate(nullptr, reinterpret_cast<const UInt8*>(bytes.data()), static_cast<CFIndex>(bytes.size()));
}

inline std::string ToText(CFDataRef data)
{
    return {reinterpret_cast<const char*>(CFDataGetBytePtr(data)), static_cast<std::size_t>(CFDataGetLength(data))};
}

// Puts a value into a dictionary, which takes the place of the caller's reference.
inline void Give(CFMutableDictionaryRef dictionary, const char* key, CFTypeRef value)
{
    const CFOwner name(MakeString(key));
    const CFOwner owner(value);
    CFDictionarySetValue(dictionary, name.get(), value);
}

inline CFMutableDictionaryRef MakeDictionary()
{
    return CFDictionaryCreateMutable(nullptr, 0, &kCFTypeDictionaryKeyCallBacks, &kCFTypeDictionaryValueCallBacks);
}

} // namespace zebaudiofilterhost::xau
