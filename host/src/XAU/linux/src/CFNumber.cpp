#include "CoreFoundation/CFNumber.h"

#include "host/src/XAU/linux/src/CFNumberObject.h"

#include <cmath>
#include <cstring>
#include <functional>
#include <limits>

using namespace zebaudiofilterhost::xau;

namespace
{

// The C types behind the numbers, of 64-bit processes. 0 for an unknown type.
CFNumberType ToSizedType(CFNumberType type)
{
    switch (type)
    {
    case kCFNumberSInt8Type:
    case kCFNumberCharType:
        return kCFNumberSInt8Type;
    case kCFNumberSInt16Type:
    case kCFNumberShortType:
        return kCFNumberSInt16Type;
    case kCFNumberSInt32Type:
    case kCFNumberIntType:
        return kCFNumberSInt32Type;
    case kCFNumberSInt64Type:
    case kCFNumberLongType:
    case kCFNumberLongLongType:
    case kCFNumberCFIndexType:
    case kCFNumberNSIntegerType:
        return kCFNumberSInt64Type;
    case kCFNumberFloat32Type:
    case kCFNumberFloatType:
        return kCFNumberFloat32Type;
    case kCFNumberFloat64Type:
    case kCFNumberDoubleType:
    case kCFNumberCGFloatType:
        return kCFNumberFloat64Type;
    default:
        return CFNumberType{};
    }
}

template <typename T>
T Read(const void* value)
{
    T number;
    std::memcpy(&number, value, sizeof(number));
    return number;
}

template <typename T>
Boolean Write(const CFOpaqueNumber::Value& value, void* buffer)
{
    const T number = std::visit(
        [](auto from)
        {
            if constexpr (std::is_integral_v<T> && std::is_floating_point_v<decltype(from)>)
            {
                // The next integer above the largest is a power of two, hence exact as a floating-point number.
                const double above = std::ldexp(1.0, std::numeric_limits<T>::digits);
                if (std::isnan(from))
                    return T{0};
                if (from >= above)
                    return std::numeric_limits<T>::max();
                if (from < -above)
                    return std::numeric_limits<T>::min();
            }
            return static_cast<T>(from);
        },
        value);
    std::memcpy(buffer, &number, sizeof(number));
    const auto survives = [number](auto from)
    {
        using From = decltype(from);
        if constexpr (std::is_floating_point_v<From> && std::is_floating_point_v<T>)
            return static_cast<From>(number) == from || std::isnan(from);
        else if constexpr (std::is_integral_v<From> && std::is_integral_v<T>)
            return static_cast<SInt64>(number) == from;
        else
            return static_cast<long double>(number) == static_cast<long double>(from);
    };
    return std::visit(survives, value) ? 1 : 0;
}

constinit const CFOpaqueBoolean sTrue(true);
constinit const CFOpaqueBoolean sFalse(false);

} // namespace

const CFBooleanRef kCFBooleanTrue = &sTrue;
const CFBooleanRef kCFBooleanFalse = &sFalse;

bool CFOpaqueNumber::Equals(const Object& other) const
{
    const auto compare = [](auto a, auto b)
    {
        return static_cast<long double>(a) == static_cast<long double>(b);
    };
    return std::visit(compare, mValue, static_cast<const CFOpaqueNumber&>(other).mValue);
}

CFHashCode CFOpaqueNumber::Hash() const
{
    // Equal numbers have equal hashes, whatever their types.
    return std::visit([](auto value) { return std::hash<double>()(static_cast<double>(value)); }, mValue);
}

CFHashCode CFOpaqueDate::Hash() const
{
    return std::hash<double>()(mTime);
}

CFTypeID CFNumberGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::Number);
}

CFNumberRef CFNumberCreate(CFAllocatorRef /*allocator*/, CFNumberType type, const void* value)
{
    const CFNumberType sized = ToSizedType(type);
    switch (sized)
    {
    case kCFNumberSInt8Type:
        return new CFOpaqueNumber(SInt64{Read<SInt8>(value)}, sized);
    case kCFNumberSInt16Type:
        return new CFOpaqueNumber(SInt64{Read<SInt16>(value)}, sized);
    case kCFNumberSInt32Type:
        return new CFOpaqueNumber(SInt64{Read<SInt32>(value)}, sized);
    case kCFNumberSInt64Type:
        return new CFOpaqueNumber(Read<SInt64>(value), sized);
    case kCFNumberFloat32Type:
        return new CFOpaqueNumber(Float64{Read<Float32>(value)}, sized);
    case kCFNumberFloat64Type:
        return new CFOpaqueNumber(Read<Float64>(value), sized);
    default:
        return nullptr;
    }
}

CFNumberType CFNumberGetType(CFNumberRef number)
{
    return number->mNumberType;
}

Boolean CFNumberIsFloatType(CFNumberRef number)
{
    return std::holds_alternative<Float64>(number->mValue) ? 1 : 0;
}

Boolean CFNumberGetValue(CFNumberRef number, CFNumberType type, void* value)
{
    switch (ToSizedType(type))
    {
    case kCFNumberSInt8Type:
        return Write<SInt8>(number->mValue, value);
    case kCFNumberSInt16Type:
        return Write<SInt16>(number->mValue, value);
    case kCFNumberSInt32Type:
        return Write<SInt32>(number->mValue, value);
    case kCFNumberSInt64Type:
        return Write<SInt64>(number->mValue, value);
    case kCFNumberFloat32Type:
        return Write<Float32>(number->mValue, value);
    case kCFNumberFloat64Type:
        return Write<Float64>(number->mValue, value);
    default:
        return 0;
    }
}

CFTypeID CFBooleanGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::Boolean);
}

Boolean CFBooleanGetValue(CFBooleanRef boolean)
{
    return boolean->mValue ? 1 : 0;
}

CFTypeID CFDateGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::Date);
}

CFDateRef CFDateCreate(CFAllocatorRef /*allocator*/, CFAbsoluteTime time)
{
    return new CFOpaqueDate(time);
}

CFAbsoluteTime CFDateGetAbsoluteTime(CFDateRef date)
{
    return date->mTime;
}
