#pragma once

#include "CoreFoundation/CFBase.h"

#include <atomic>
#include <memory>

namespace zebaudiofilterhost::xau::cf
{

enum class TypeID : CFTypeID
{
    Allocator = 1,
    String,
    Number,
    Boolean,
    Date,
    Data,
    Array,
    Dictionary,
    URL,
    ReadStream,
    WriteStream,
    RunLoop
};

/// What every reference points to. Made with a count of 1 for whoever called Create or Copy.
class Object
{
public:
    enum class Life
    {
        Counted,
        Process // Retain and Release count nothing
    };

    explicit constexpr Object(TypeID type, Life life = Life::Counted) : mType(type), mLife(life) {}
    Object(const Object&) = delete;
    Object& operator=(const Object&) = delete;
    virtual ~Object() = default;

    TypeID GetTypeID() const { return mType; }
    void Retain() const;
    void Release() const;
    CFIndex GetRetainCount() const { return mCount.load(std::memory_order_relaxed); }

    /// `other` has this object's type. Without an override only an object itself is equal.
    virtual bool Equals(const Object& other) const { return this == &other; }
    virtual CFHashCode Hash() const;

private:
    mutable std::atomic<CFIndex> mCount = 1;
    TypeID mType;
    Life mLife;
};

/// The object behind a reference of any kind: each kind's class has Object as its first and only base.
inline const Object& ToObject(CFTypeRef object)
{
    return *static_cast<const Object*>(object);
}

struct ReleaseObject
{
    void operator()(const void* object) const { CFRelease(object); }
};

/// One reference, released at the end.
using ObjectPtr = std::unique_ptr<const void, ReleaseObject>;

/// Null unless the object is of that type. Null gives null.
template <typename T>
const T* ToType(CFTypeRef object, TypeID type)
{
    return object && ToObject(object).GetTypeID() == type ? static_cast<const T*>(object) : nullptr;
}

} // namespace zebaudiofilterhost::xau::cf
