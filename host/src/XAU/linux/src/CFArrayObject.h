#pragma once

#include "CoreFoundation/CFArray.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <vector>

struct CFOpaqueArray final : zebaudiofilterhost::xau::cf::Object
{
    /// Null callbacks: bare pointers.
    explicit CFOpaqueArray(const CFArrayCallBacks* callBacks);
    ~CFOpaqueArray() override;

    void Append(const void* value);
    void Clear();

    bool Equals(const Object& other) const override;
    CFHashCode Hash() const override { return mValues.size(); }

    CFArrayCallBacks mCallBacks = {};
    std::vector<const void*> mValues;
};
