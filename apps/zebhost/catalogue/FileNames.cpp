#include "catalogue/FileNames.h"

#include <charconv>

namespace zebhost
{

namespace
{

bool IsPlain(char letter, bool first)
{
    const auto byte = static_cast<unsigned char>(letter);
    const bool isWord = (byte >= '0' && byte <= '9') || (byte >= 'A' && byte <= 'Z') || (byte >= 'a' && byte <= 'z');
    return isWord || byte >= 0x80 || byte == '_' || byte == '-' || (!first && (byte == ' ' || byte == '.'));
}

} // namespace

std::string EncodeFileName(std::string_view text)
{
    constexpr std::string_view kDigits = "0123456789ABCDEF";
    std::string name;
    for (std::size_t at = 0; at < text.size(); ++at)
    {
        if (IsPlain(text[at], at == 0))
        {
            name += text[at];
        }
        else
        {
            const auto byte = static_cast<unsigned char>(text[at]);
            name += '%';
            name += kDigits[byte >> 4U];
            name += kDigits[byte & 15U];
        }
    }
    return name;
}

std::string DecodeFileName(std::string_view name)
{
    std::string text;
    for (std::size_t at = 0; at < name.size(); ++at)
    {
        unsigned int byte = 0;
        const bool isCode = name[at] == '%' && at + 2 < name.size();
        if (isCode &&
            std::from_chars(name.data() + at + 1, name.data() + at + 3, byte, 16).ptr == name.data() + at + 3)
        {
            text += static_cast<char>(byte);
            at += 2;
        }
        else
        {
            text += name[at];
        }
    }
    return text;
}

} // namespace zebhost
