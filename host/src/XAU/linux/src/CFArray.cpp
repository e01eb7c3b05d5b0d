#include "CoreFoundation/CFArray.h"

#include "host/src/XAU/linux/src/CFArrayObject.h"
#include "host/src/XAU/linux/src/CFObjectCallBacks.h"

#include <algorithm>

using namespace zebaudiofilterhost::xau;

const CFArrayCallBacks kCFTypeArrayCallBacks = {0, cf::RetainValue, cf::ReleaseValue, nullptr, CFEqual};

CFOpaqueArray::CFOpaqueArray(const CFArrayCallBacks* callBacks) : Object(cf::TypeID::Array)
{
    if (callBacks)
        mCallBacks = *callBacks;
}

CFOpaqueArray::~CFOpaqueArray()
{
    Clear();
}

void CFOpaqueArray::Append(const void* value)
{
    mValues.push_back(mCallBacks.retain ? mCallBacks.retain(nullptr, value) : value);
}

void CFOpaqueArray::Clear()
{
    if (mCallBacks.release)
    {
        for (const void* value : mValues)
            mCallBacks.release(nullptr, value);
    }
    mValues.clear();
}

bool CFOpaqueArray::Equals(const Object& other) const
{
    const auto& values = static_cast<const CFOpaqueArray&>(other).mValues;
    return std::equal(mValues.begin(), mValues.end(), values.begin(), values.end(),
                      [this](const void* a, const void* b)
                      { return a == b || (mCallBacks.equal != nullptr && mCallBacks.equal(a, b) != 0); });
}

CFTypeID CFArrayGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::Array);
}

CFArrayRef CFArrayCreate(CFAllocatorRef /*allocator*/, const void** values, CFIndex count,
                         const CFArrayCallBacks* callBacks)
{
    auto* array = new CFOpaqueArray(callBacks);
    for (CFIndex index = 0; index < count; ++index)
        array->Append(values[index]);
    return array;
}

CFArrayRef CFArrayCreateCopy(CFAllocatorRef /*allocator*/, CFArrayRef array)
{
    auto* copy = new CFOpaqueArray(&array->mCallBacks);
    for (const void* value : array->mValues)
        copy->Append(value);
    return copy;
}

CFMutableArrayRef CFArrayCreateMutable(CFAllocatorRef /*allocator*/, CFIndex /*capacity*/,
                                       const CFArrayCallBacks* callBacks)
{
    return new CFOpaqueArray(callBacks);
}

CFIndex CFArrayGetCount(CFArrayRef array)
{
    return static_cast<CFIndex>(array->mValues.size());
}

const void* CFArrayGetValueAtIndex(CFArrayRef array, CFIndex index)
{
    return array->mValues.at(static_cast<std::size_t>(index));
}

void CFArrayAppendValue(CFMutableArrayRef array, const void* value)
{
    array->Append(value);
}

void CFArrayRemoveAllValues(CFMutableArrayRef array)
{
    array->Clear();
}
