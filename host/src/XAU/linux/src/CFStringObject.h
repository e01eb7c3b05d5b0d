#pragma once

#include "CoreFoundation/CFString.h"
#include "host/src/XAU/linux/src/CFObject.h"

#include <string>
#include <string_view>
#include <utility>

struct CFOpaqueString final : zebaudiofilterhost::xau::cf::Object
{
    explicit CFOpaqueString(std::u16string text, Life life = Life::Counted)
        : Object(zebaudiofilterhost::xau::cf::TypeID::String, life), mText(std::move(text))
    {
    }

    bool Equals(const Object& other) const override;
    CFHashCode Hash() const override;

    const std::u16string mText;
};

namespace zebaudiofilterhost::xau::cf
{

/// False if the bytes are not of that encoding, or if it is not known.
bool Decode(std::string_view bytes, CFStringEncoding encoding, std::u16string& text);

/// False if the encoding lacks a character of the text, or is not known.
bool Encode(std::u16string_view text, CFStringEncoding encoding, std::string& bytes);

/// Null for null; what is no UTF-16 is replaced.
std::string ToUTF8(CFStringRef text);

} // namespace zebaudiofilterhost::xau::cf
