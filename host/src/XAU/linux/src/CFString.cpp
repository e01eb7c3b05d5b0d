#include "CoreFoundation/CFString.h"

#include "host/src/XAU/linux/src/CFStringObject.h"

#include <algorithm>
#include <cstring>
#include <functional>
#include <map>
#include <memory>
#include <mutex>

using namespace zebaudiofilterhost::xau;

namespace
{

UniChar FoldAscii(UniChar unit)
{
    return unit >= u'A' && unit <= u'Z' ? static_cast<UniChar>(unit + (u'a' - u'A')) : unit;
}

std::u16string Fold(const std::u16string& text)
{
    std::u16string folded(text.size(), u'\0');
    std::transform(text.begin(), text.end(), folded.begin(), FoldAscii);
    return folded;
}

} // namespace

bool CFOpaqueString::Equals(const Object& other) const
{
    return mText == static_cast<const CFOpaqueString&>(other).mText;
}

CFHashCode CFOpaqueString::Hash() const
{
    return std::hash<std::u16string>()(mText);
}

CFTypeID CFStringGetTypeID()
{
    return static_cast<CFTypeID>(cf::TypeID::String);
}

CFStringRef CFStringCreateWithBytes(CFAllocatorRef /*allocator*/, const UInt8* bytes, CFIndex count,
                                    CFStringEncoding encoding, Boolean /*isExternalRepresentation*/)
{
    if (count < 0 || (!bytes && count > 0))
        return nullptr;
    const std::string_view view(reinterpret_cast<const char*>(bytes), static_cast<std::size_t>(count));
    std::u16string text;
    return cf::Decode(view, encoding, text) ? new CFOpaqueString(std::move(text)) : nullptr;
}

CFStringRef CFStringCreateWithCString(CFAllocatorRef allocator, const char* text, CFStringEncoding encoding)
{
    if (!text)
        return nullptr;
    return CFStringCreateWithBytes(allocator, reinterpret_cast<const UInt8*>(text),
                                   static_cast<CFIndex>(std::strlen(text)), encoding, 0);
}

CFStringRef CFStringCreateWithCharacters(CFAllocatorRef /*allocator*/, const UniChar* units, CFIndex count)
{
    if (count < 0 || (!units && count > 0))
        return nullptr;
    return new CFOpaqueString(count == 0 ? std::u16string() : std::u16string(units, static_cast<std::size_t>(count)));
}

CFStringRef CFStringCreateCopy(CFAllocatorRef /*allocator*/, CFStringRef text)
{
    CFRetain(text); // it never changes
    return text;
}

CFStringRef CFStringCreateWithSubstring(CFAllocatorRef /*allocator*/, CFStringRef text, CFRange range)
{
    const auto size = static_cast<CFIndex>(text->mText.size());
    if (range.location < 0 || range.length < 0 || range.location > size || range.length > size - range.location)
        return nullptr;
    return new CFOpaqueString(
        text->mText.substr(static_cast<std::size_t>(range.location), static_cast<std::size_t>(range.length)));
}

CFIndex CFStringGetLength(CFStringRef text)
{
    return static_cast<CFIndex>(text->mText.size());
}

UniChar CFStringGetCharacterAtIndex(CFStringRef text, CFIndex index)
{
    return text->mText.at(static_cast<std::size_t>(index));
}

void CFStringGetCharacters(CFStringRef text, CFRange range, UniChar* buffer)
{
    text->mText.copy(buffer, static_cast<std::size_t>(range.length), static_cast<std::size_t>(range.location));
}

Boolean CFStringGetCString(CFStringRef text, char* buffer, CFIndex size, CFStringEncoding encoding)
{
    std::string bytes;
    const std::size_t zero = encoding == kCFStringEncodingUTF16 ? sizeof(UniChar) : sizeof(char);
    if (size < 0 || !cf::Encode(text->mText, encoding, bytes) || bytes.size() + zero > static_cast<std::size_t>(size))
        return 0;
    bytes.append(zero, '\0');
    bytes.copy(buffer, bytes.size());
    return 1;
}

CFIndex CFStringGetMaximumSizeForEncoding(CFIndex length, CFStringEncoding encoding)
{
    constexpr CFIndex kUTF8BytesPerUnit = 3; // a pair of units makes four bytes
    switch (encoding)
    {
    case kCFStringEncodingUTF8:
        return length * kUTF8BytesPerUnit;
    case kCFStringEncodingUTF16:
        return length * static_cast<CFIndex>(sizeof(UniChar));
    default:
        return length;
    }
}

CFComparisonResult CFStringCompare(CFStringRef a, CFStringRef b, CFOptionFlags flags)
{
    const bool folds = (flags & kCFCompareCaseInsensitive) != 0;
    const int order = folds ? Fold(a->mText).compare(Fold(b->mText)) : a->mText.compare(b->mText);
    if (order == 0)
        return kCFCompareEqualTo;
    return order < 0 ? kCFCompareLessThan : kCFCompareGreaterThan;
}

CFStringRef CFStringMakeConstantString(const char* text)
{
    static std::mutex sMutex;
    static std::map<std::string, std::unique_ptr<const CFOpaqueString>, std::less<>> sConstants;
    const std::lock_guard lock(sMutex);
    const auto known = sConstants.find(text);
    if (known != sConstants.end())
        return known->second.get();
    auto constant =
        std::make_unique<CFOpaqueString>(std::u16string(text, text + std::strlen(text)), cf::Object::Life::Process);
    return sConstants.emplace(text, std::move(constant)).first->second.get();
}
