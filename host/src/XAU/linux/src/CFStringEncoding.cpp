#include "host/src/XAU/linux/src/CFStringObject.h"

#include <utf8.h>

#include <algorithm>
#include <cstring>
#include <iterator>

namespace zebaudiofilterhost::xau::cf
{

namespace
{

// Of the encodings that are a part of the first 256 characters: how many they know. 0 for others.
unsigned int CountCharacters(CFStringEncoding encoding)
{
    switch (encoding)
    {
    case kCFStringEncodingASCII:
    case kCFStringEncodingMacRoman:
        return 128;
    case kCFStringEncodingISOLatin1:
        return 256;
    default:
        return 0;
    }
}

bool DecodeUTF16(std::string_view bytes, std::u16string& text)
{
    if (bytes.size() % sizeof(UniChar) != 0)
        return false;
    text.resize(bytes.size() / sizeof(UniChar));
    if (!bytes.empty())
        std::memcpy(text.data(), bytes.data(), bytes.size());
    return true;
}

bool DecodeUTF8(std::string_view bytes, std::u16string& text)
{
    if (!utf8::is_valid(bytes.begin(), bytes.end()))
        return false;
    text.clear();
    utf8::utf8to16(bytes.begin(), bytes.end(), std::back_inserter(text));
    return true;
}

void AppendUTF8(std::u16string_view text, std::string& bytes)
{
    constexpr UniChar kReplacement = 0xFFFD;
    for (std::size_t index = 0; index < text.size(); ++index)
    {
        const std::u16string_view one = text.substr(index, 1);
        const bool isPair = utf8::internal::is_lead_surrogate(one[0]) && index + 1 < text.size() &&
                            utf8::internal::is_trail_surrogate(text[index + 1]);
        if (isPair)
        {
            const std::u16string_view pair = text.substr(index++, 2);
            utf8::utf16to8(pair.begin(), pair.end(), std::back_inserter(bytes));
            continue;
        }
        utf8::append(utf8::internal::is_surrogate(one[0]) ? kReplacement : one[0], std::back_inserter(bytes));
    }
}

} // namespace

bool Decode(std::string_view bytes, CFStringEncoding encoding, std::u16string& text)
{
    if (encoding == kCFStringEncodingUTF8)
        return DecodeUTF8(bytes, text);
    if (encoding == kCFStringEncodingUTF16)
        return DecodeUTF16(bytes, text);

    const unsigned int known = CountCharacters(encoding);
    text.clear();
    for (const char byte : bytes)
    {
        const auto unit = static_cast<unsigned char>(byte);
        if (unit >= known)
            return false;
        text.push_back(unit);
    }
    return known != 0;
}

bool Encode(std::u16string_view text, CFStringEncoding encoding, std::string& bytes)
{
    bytes.clear();
    if (encoding == kCFStringEncodingUTF8)
    {
        AppendUTF8(text, bytes);
        return true;
    }
    if (encoding == kCFStringEncodingUTF16)
    {
        bytes.resize(text.size() * sizeof(UniChar));
        if (!text.empty())
            std::memcpy(bytes.data(), text.data(), bytes.size());
        return true;
    }

    const unsigned int known = CountCharacters(encoding);
    if (!std::all_of(text.begin(), text.end(), [known](UniChar unit) { return unit < known; }))
        return false;
    for (const UniChar unit : text)
        bytes.push_back(static_cast<char>(unit));
    return known != 0;
}

std::string ToUTF8(CFStringRef text)
{
    std::string bytes;
    if (text)
        AppendUTF8(text->mText, bytes);
    return bytes;
}

} // namespace zebaudiofilterhost::xau::cf
