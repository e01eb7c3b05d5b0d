#pragma once

#include "CoreFoundation/CFData.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <utility>
#include <vector>

struct CFOpaqueData final : zebaudiofilterhost::xau::cf::Object
{
    explicit CFOpaqueData(std::vector<UInt8> bytes)
        : Object(zebaudiofilterhost::xau::cf::TypeID::Data), mBytes(std::move(bytes))
    {
    }

    bool Equals(const Object& other) const override
    {
        return mBytes == static_cast<const CFOpaqueData&>(other).mBytes;
    }
    CFHashCode Hash() const override;

    std::vector<UInt8> mBytes;
};
