#include "host/src/XAU/linux/src/CFObject.h"

#include <functional>

using zebaudiofilterhost::xau::cf::Object;
using zebaudiofilterhost::xau::cf::ToObject;
using zebaudiofilterhost::xau::cf::TypeID;

struct CFOpaqueAllocator final : Object
{
    constexpr CFOpaqueAllocator() : Object(TypeID::Allocator, Life::Process) {}
};

namespace
{

constinit const CFOpaqueAllocator sMalloc;
constinit const CFOpaqueAllocator sNull;

} // namespace

const CFAllocatorRef kCFAllocatorDefault = nullptr;
const CFAllocatorRef kCFAllocatorMalloc = &sMalloc;
const CFAllocatorRef kCFAllocatorNull = &sNull;

namespace zebaudiofilterhost::xau::cf
{

void Object::Retain() const
{
    if (mLife == Life::Counted)
        mCount.fetch_add(1, std::memory_order_relaxed); // whoever retains has a reference already
}

void Object::Release() const
{
    // What other threads did with the object before their last release happens before its end.
    if (mLife == Life::Counted && mCount.fetch_sub(1, std::memory_order_acq_rel) == 1)
        delete this;
}

CFHashCode Object::Hash() const
{
    return std::hash<const Object*>()(this);
}

} // namespace zebaudiofilterhost::xau::cf

CFTypeRef CFRetain(CFTypeRef object)
{
    ToObject(object).Retain();
    return object;
}

void CFRelease(CFTypeRef object)
{
    ToObject(object).Release();
}

CFIndex CFGetRetainCount(CFTypeRef object)
{
    return ToObject(object).GetRetainCount();
}

CFTypeID CFGetTypeID(CFTypeRef object)
{
    return static_cast<CFTypeID>(ToObject(object).GetTypeID());
}

Boolean CFEqual(CFTypeRef a, CFTypeRef b)
{
    const Object& one = ToObject(a);
    const Object& other = ToObject(b);
    return &one == &other || (one.GetTypeID() == other.GetTypeID() && one.Equals(other)) ? 1 : 0;
}

CFHashCode CFHash(CFTypeRef object)
{
    return ToObject(object).Hash();
}
