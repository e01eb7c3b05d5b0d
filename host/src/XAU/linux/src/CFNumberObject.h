#pragma once

#include "CoreFoundation/CFNumber.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <variant>

struct CFOpaqueNumber final : zebaudiofilterhost::xau::cf::Object
{
    using Value = std::variant<SInt64, Float64>;

    /// `type` is a sized one, 1 to 6.
    CFOpaqueNumber(Value value, CFNumberType type)
        : Object(zebaudiofilterhost::xau::cf::TypeID::Number), mValue(value), mNumberType(type)
    {
    }

    bool Equals(const Object& other) const override;
    CFHashCode Hash() const override;

    const Value mValue;
    const CFNumberType mNumberType;
};

struct CFOpaqueBoolean final : zebaudiofilterhost::xau::cf::Object
{
    constexpr explicit CFOpaqueBoolean(bool value)
        : Object(zebaudiofilterhost::xau::cf::TypeID::Boolean, Life::Process), mValue(value)
    {
    }

    const bool mValue;
};

struct CFOpaqueDate final : zebaudiofilterhost::xau::cf::Object
{
    explicit CFOpaqueDate(CFAbsoluteTime time) : Object(zebaudiofilterhost::xau::cf::TypeID::Date), mTime(time) {}

    bool Equals(const Object& other) const override { return mTime == static_cast<const CFOpaqueDate&>(other).mTime; }
    CFHashCode Hash() const override;

    const CFAbsoluteTime mTime;
};
